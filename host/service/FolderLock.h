#pragma once
#include <wx/string.h>

// One process at a time works a hot folder: the service for each folder it
// serves, or a "hotfolder run". The holder keeps an advisory lock on a file
// in the folder's container and writes who it is into it; the kernel drops
// the lock however the holder ends, so nothing stale is left behind.
class FolderLock
{
public:
    enum class Holder
    {
        Service,
        Run
    };

    FolderLock() = default;
    ~FolderLock();
    FolderLock(const FolderLock&) = delete;
    FolderLock& operator=(const FolderLock&) = delete;

    // False with a reason naming the holder ("served by the hot-folder
    // service, pid N", "another run, pid N") when another process holds it.
    bool Acquire(const wxString& container, Holder holder, wxString& error);
    // Whoever holds the folder's lock, described; empty when nobody does.
    static wxString HolderOf(const wxString& container);

    static const char kFileName[];

private:
    int m_fd = -1;
};
