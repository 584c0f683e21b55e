#include "posix/UniqueFd.h"

#include <unistd.h>

namespace posix
{
UniqueFd& UniqueFd::operator=(UniqueFd&& other) noexcept
{
    if (this != &other)
        Reset(other.Release());
    return *this;
}

int UniqueFd::Release()
{
    const int fd = m_fd;
    m_fd = -1;
    return fd;
}

void UniqueFd::Reset(int fd)
{
    if (m_fd >= 0 && m_fd != fd)
        ::close(m_fd);
    m_fd = fd;
}

bool UniqueFd::Close()
{
    if (m_fd < 0)
        return true;
    return ::close(Release()) == 0;
}
} // namespace posix
