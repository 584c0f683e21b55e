#pragma once
// Internal: an advisory lock held while a shared file is read, changed and
// replaced, so concurrent writers in other processes lose nothing.
#include <wx/string.h>

namespace db
{
class FileLock
{
public:
    // Blocks until the exclusive lock on lockPath (created when missing) is
    // held. Without a lock file the work goes on unlocked.
    explicit FileLock(const wxString& lockPath);
    ~FileLock();
    FileLock(const FileLock&) = delete;
    FileLock& operator=(const FileLock&) = delete;

private:
    int m_iFd = -1;
};
} // namespace db
