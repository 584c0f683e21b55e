// Folder clean-up through system calls only: paths never reach a shell, so
// blanks, quotes and shell metacharacters in names are harmless.
#include "FileSystemUtils.h"

#include <fcntl.h>
#include <ftw.h>
#include <linux/fs.h>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "posix/Directories.h"
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

thread_local bool walkOk = true;

int MakeEntryWritable(const char* path, const struct stat* info, int type, struct FTW*)
{
    if (type == FTW_NS)
    {
        walkOk = false;
        return 0;
    }
    if (type == FTW_SL || type == FTW_SLN)
        return 0; // links are removed, never followed or changed
    if (!ClearImmutableFlag(path, *info))
        walkOk = false;
    if (chmod(path, 0777) != 0)
        walkOk = false;
    return 0;
}

constexpr int kOpenDescriptors = 32;
} // namespace

bool MakeFolderWritable(const char* path)
{
    if (!IsExistingPath(path))
        return false;
    walkOk = true;
    // Pre-order, so a folder is opened up before its entries are visited.
    if (nftw(path, MakeEntryWritable, kOpenDescriptors, FTW_PHYS) != 0)
        return false;
    return walkOk;
}

void DeleteFolderChildren(const char* folder)
{
    if (!IsExistingPath(folder))
        return;
    MakeFolderWritable(folder);
    posix::RemoveTree(folder); // the folder itself too, despite the name
}
