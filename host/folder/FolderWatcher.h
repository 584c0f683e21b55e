#pragma once
#include <chrono>
#include <map>
#include <vector>

#include <wx/string.h>

#include "posix/UniqueFd.h"

// Wakes the watch loop when something changes in a folder (inotify). The loop
// still rescans on every wake-up and on a short tick, so an overflowed or
// missed event only delays a file, it never loses one.
class FolderWatcher
{
public:
    FolderWatcher() = default;
    FolderWatcher(const FolderWatcher&) = delete;
    FolderWatcher& operator=(const FolderWatcher&) = delete;

    bool Watch(const wxString& folder, wxString& error);
    // Returns after a change, a stop request, or timeoutMs.
    void Wait(int timeoutMs);

private:
    posix::UniqueFd m_fd; // the inotify instance
};

// A file is taken only when its size and modification time have stayed the
// same for the settle time: a writer still copying it in keeps changing both.
class SettleTracker
{
public:
    explicit SettleTracker(std::chrono::milliseconds settle) : m_settle(settle) {}

    // Of the files present now, those that have been still long enough.
    // Files no longer present are forgotten.
    std::vector<wxString> Settled(const std::vector<wxString>& present);

private:
    struct Seen
    {
        long long size;
        long long mtimeNs;
        std::chrono::steady_clock::time_point since;
    };
    std::chrono::milliseconds m_settle;
    std::map<wxString, Seen> m_files;
};

// Regular files and symbolic links (to be refused), visible, directly in
// folder, sorted by name.
std::vector<wxString> ListFolderFiles(const wxString& folder);

// Size and modification time of a file (of a link itself), for telling a changed file from the
// one seen before; false when it is gone.
bool FileSignature(const wxString& path, long long& size, long long& mtimeNs);
