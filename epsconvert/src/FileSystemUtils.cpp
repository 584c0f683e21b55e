// Folder clean-up through system calls only: paths never reach a shell, so
// blanks, quotes and shell metacharacters in names are harmless.
#include "FileSystemUtils.h"

#include <fcntl.h>
#include <linux/fs.h>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "posix/Directories.h"
#include "posix/UniqueDir.h"
#include "posix/UniqueFd.h"

namespace
{
bool IsExistingPath(const char* path)
{
    struct stat info;
    return path && *path && lstat(path, &info) == 0;
}

// Clears the immutable and append-only flags where set. Only regular files
// and folders carry them; opening anything else could block or have effects.
bool ClearImmutableFlag(const char* path, const struct stat& info)
{
    if (!S_ISREG(info.st_mode) && !S_ISDIR(info.st_mode))
        return true;
    const posix::UniqueFd fd(open(path, O_RDONLY | O_NONBLOCK | O_NOFOLLOW | O_CLOEXEC | O_NOCTTY));
    if (!fd)
        return true; // nothing we could change; chmod will tell
    int flags = 0;
    if (ioctl(fd.Get(), FS_IOC_GETFLAGS, &flags) == 0 && (flags & (FS_IMMUTABLE_FL | FS_APPEND_FL)))
    {
        flags &= ~(FS_IMMUTABLE_FL | FS_APPEND_FL);
        return ioctl(fd.Get(), FS_IOC_SETFLAGS, &flags) == 0;
    }
    return true;
}

bool IsDotOrDotDot(const char* name)
{
    return name[0] == '.' && (name[1] == '\0' || (name[1] == '.' && name[2] == '\0'));
}

// Opens up one entry; false when it could not be made writable. Links are
// removed, never followed or changed.
bool MakeEntryWritable(const char* path, const struct stat& info)
{
    if (S_ISLNK(info.st_mode))
        return true;
    const bool flagCleared = ClearImmutableFlag(path, info);
    return chmod(path, 0777) == 0 && flagCleared;
}

// The names in a folder, "." and ".." left out; false when it cannot be read.
bool ListFolder(const std::string& folder, std::vector<std::string>& names)
{
    posix::UniqueDir dir(folder.c_str());
    if (!dir)
        return false;
    while (const dirent* entry = dir.Next())
        if (!IsDotOrDotDot(entry->d_name))
            names.emplace_back(entry->d_name);
    return true;
}
} // namespace

bool MakeFolderWritable(const char* path)
{
    if (!IsExistingPath(path))
        return false;
    bool ok = true;
    // A folder is opened up before it is read, so that one nobody could
    // read (mode 0) has its entries visited too. Folders still to visit are
    // kept by name: one is open at a time, however deep the tree.
    std::vector<std::string> pending{path};
    while (!pending.empty())
    {
        const std::string entry = std::move(pending.back());
        pending.pop_back();
        struct stat info;
        if (lstat(entry.c_str(), &info) != 0)
        {
            ok = false;
            continue;
        }
        if (!MakeEntryWritable(entry.c_str(), info))
            ok = false;
        if (!S_ISDIR(info.st_mode))
            continue;
        std::vector<std::string> names;
        if (!ListFolder(entry, names))
        {
            ok = false;
            continue;
        }
        for (const std::string& name : names)
            pending.push_back(entry + "/" + name);
    }
    return ok;
}

void DeleteFolderChildren(const char* folder)
{
    if (!IsExistingPath(folder))
        return;
    MakeFolderWritable(folder);
    posix::RemoveTree(folder); // the folder itself too, despite the name
}
