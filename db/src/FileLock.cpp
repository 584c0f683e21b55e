#include "FileLock.h"

#include <cerrno>
#include <string>

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

namespace db
{
FileLock::FileLock(const wxString& lockPath)
{
    const std::string path(lockPath.fn_str());
    m_iFd = ::open(path.c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0666);
    if (m_iFd < 0)
        return;
    // Any user of the machine may take the lock next.
    ::fchmod(m_iFd, 0666);
    while (::flock(m_iFd, LOCK_EX) != 0 && errno == EINTR)
    {
    }
}

FileLock::~FileLock()
{
    if (m_iFd >= 0)
        ::close(m_iFd); // releases the lock
}
} // namespace db
