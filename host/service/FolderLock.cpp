#include "service/FolderLock.h"

#include <cerrno>
#include <chrono>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <string>
#include <sys/file.h>
#include <thread>
#include <unistd.h>

#include <wx/filename.h>

const char FolderLock::kFileName[] = "folder.lock";

namespace
{
wxString LockPath(const wxString& container)
{
    return wxFileName(container, FolderLock::kFileName).GetFullPath();
}

// "service 123" or "run 123", as the holder wrote it.
wxString Describe(int fd)
{
    // The holder writes its name just after taking the lock: give it a moment.
    for (int attempt = 0; attempt < 50; ++attempt)
    {
        char text[64] = {};
        const ssize_t got = pread(fd, text, sizeof text - 1, 0);
        const std::string holder(text, got > 0 ? static_cast<size_t>(got) : 0);
        const size_t blank = holder.find(' ');
        if (blank != std::string::npos && holder.back() == '\n')
        {
            const long pid = std::atol(holder.c_str() + blank + 1);
            return wxString::Format(holder.compare(0, blank, "service") == 0
                                        ? "served by the hot-folder service, pid %ld"
                                        : "worked by another run, pid %ld",
                                    pid);
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(2));
    }
    return "worked by another process";
}
} // namespace

FolderLock::~FolderLock()
{
    if (m_fd >= 0)
        close(m_fd);
}

bool FolderLock::Acquire(const wxString& container, Holder holder, wxString& error)
{
    const wxString path = LockPath(container);
    m_fd = open(path.fn_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0644);
    // Another user's lock file still locks; only the holder's name goes unsaid.
    const bool writable = m_fd >= 0;
    if (m_fd < 0 && errno == EACCES)
        m_fd = open(path.fn_str(), O_RDONLY | O_CLOEXEC);
    if (m_fd < 0)
    {
        error = wxString::Format("cannot open the folder lock %s: %s", path,
                                 wxString::FromUTF8(std::strerror(errno)));
        return false;
    }
    if (flock(m_fd, LOCK_EX | LOCK_NB) != 0)
    {
        error = errno == EWOULDBLOCK ? "the folder is " + Describe(m_fd)
                                     : wxString::Format("cannot lock %s: %s", path,
                                                        wxString::FromUTF8(std::strerror(errno)));
        close(m_fd);
        m_fd = -1;
        return false;
    }
    const std::string text = std::string(holder == Holder::Service ? "service " : "run ") +
                             std::to_string(getpid()) + "\n";
    if (writable && (ftruncate(m_fd, 0) != 0 || pwrite(m_fd, text.data(), text.size(), 0) !=
                                                    static_cast<ssize_t>(text.size())))
    {
        error = "cannot write the folder lock " + path;
        close(m_fd);
        m_fd = -1;
        return false;
    }
    return true;
}

wxString FolderLock::HolderOf(const wxString& container)
{
    const int fd = open(LockPath(container).fn_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0)
        return wxString();
    wxString holder;
    if (flock(fd, LOCK_SH | LOCK_NB) != 0 && errno == EWOULDBLOCK)
        holder = Describe(fd);
    close(fd);
    return holder;
}
