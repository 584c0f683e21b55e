#include "posix/ExecutablePath.h"

#include <limits.h>
#include <unistd.h>

namespace posix
{
std::string ExecutablePath()
{
    char buffer[PATH_MAX];
    const ssize_t length = ::readlink("/proc/self/exe", buffer, sizeof buffer - 1);
    if (length <= 0)
        return std::string();
    return std::string(buffer, static_cast<size_t>(length));
}
} // namespace posix
