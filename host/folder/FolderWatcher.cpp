#include "folder/FolderWatcher.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <dirent.h>
#include <poll.h>
#include <sys/inotify.h>
#include <sys/stat.h>
#include <unistd.h>

#include <wx/filename.h>

#include "jobs/StopRequest.h"
#include "posix/NativePath.h"
#include "posix/UniqueDir.h"

bool FolderWatcher::Watch(const wxString& folder, wxString& error)
{
    m_fd.Reset(inotify_init1(IN_NONBLOCK | IN_CLOEXEC));
    if (!m_fd || inotify_add_watch(m_fd.Get(), folder.fn_str(),
                                   IN_CLOSE_WRITE | IN_MOVED_TO | IN_CREATE | IN_MODIFY |
                                       IN_ATTRIB | IN_DELETE | IN_MOVED_FROM) < 0)
    {
        error = wxString::Format("cannot watch %s: %s", folder,
                                 wxString::FromUTF8(std::strerror(errno)));
        return false;
    }
    return true;
}

void FolderWatcher::Wait(int timeoutMs)
{
    struct pollfd fds[2] = {{m_fd.Get(), POLLIN, 0}, {StopRequest::WakeDescriptor(), POLLIN, 0}};
    int count = fds[1].fd >= 0 ? 2 : 1;
    if (poll(fds, count, timeoutMs) > 0 && (fds[0].revents & POLLIN))
    {
        // Only the wake-up matters; the loop rescans the folder itself.
        alignas(struct inotify_event) char buffer[4096];
        while (read(m_fd.Get(), buffer, sizeof(buffer)) > 0)
        {
        }
    }
}

bool FileSignature(const wxString& path, long long& size, long long& mtimeNs)
{
    struct stat info;
    if (lstat(path.fn_str(), &info) != 0) // a link by itself, not what it points to
        return false;
    size = info.st_size;
    mtimeNs = static_cast<long long>(info.st_mtim.tv_sec) * 1000000000LL + info.st_mtim.tv_nsec;
    return true;
}

std::vector<wxString> SettleTracker::Settled(const std::vector<wxString>& present)
{
    auto now = std::chrono::steady_clock::now();
    std::map<wxString, Seen> kept;
    std::vector<wxString> settled;
    for (const wxString& path : present)
    {
        long long size = 0, mtime = 0;
        if (!FileSignature(path, size, mtime))
            continue;
        auto it = m_files.find(path);
        Seen seen{size, mtime, now};
        if (it != m_files.end() && it->second.size == size && it->second.mtimeNs == mtime)
            seen.since = it->second.since;
        kept[path] = seen;
        if (now - seen.since >= m_settle)
            settled.push_back(path);
    }
    m_files.swap(kept);
    return settled;
}

std::vector<wxString> ListFolderFiles(const wxString& folder)
{
    std::vector<wxString> files;
    posix::UniqueDir directory(posix::NativePath(folder).c_str());
    if (!directory)
        return files;
    while (const dirent* entry = directory.Next())
    {
        if (entry->d_name[0] == '.')
            continue;
        wxString path = wxFileName(folder, posix::FromNativePath(entry->d_name)).GetFullPath();
        struct stat info;
        // Links too, so that they are refused with the reason.
        if (lstat(path.fn_str(), &info) == 0 && (S_ISREG(info.st_mode) || S_ISLNK(info.st_mode)))
            files.push_back(path);
    }
    std::sort(files.begin(), files.end());
    return files;
}
