#include "service/ServiceLock.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

#include <wx/filename.h>

#include "db/PathResolver.h"

wxString ServiceLockPath()
{
    return db::PathResolver::GetRunServiceFileName() + ".lock";
}

ServiceLock::~ServiceLock()
{
    if (m_fd >= 0)
        close(m_fd);
}

bool ServiceLock::Acquire(wxString& error)
{
    const wxString path = ServiceLockPath();
    m_fd = open(path.fn_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0666);
    if (m_fd < 0)
    {
        error = wxString::Format("cannot open the service lock %s: %s", path,
                                 wxString::FromUTF8(std::strerror(errno)));
        return false;
    }
    if (flock(m_fd, LOCK_EX | LOCK_NB) != 0)
    {
        error = errno == EWOULDBLOCK ? wxString("a hot-folder service is running already")
                                     : wxString::Format("cannot lock %s: %s", path,
                                                        wxString::FromUTF8(std::strerror(errno)));
        close(m_fd);
        m_fd = -1;
        return false;
    }
    return true;
}

bool ServiceIsRunning()
{
    int fd = open(ServiceLockPath().fn_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0)
        return false;
    const bool held = flock(fd, LOCK_SH | LOCK_NB) != 0 && errno == EWOULDBLOCK;
    close(fd);
    return held;
}
