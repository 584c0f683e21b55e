// Folder clean-up through system calls only: paths never reach a shell, so
// blanks, quotes and shell metacharacters in names are harmless.
#include "FileSystemUtils.h"

#include <fcntl.h>
#include <ftw.h>
#include <linux/fs.h>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <string>

#include "posix/Directories.h"
#include "posix/UniqueFd.h"

namespace
{
std::string ToNativePath(wxString const& path)
{
    const wxScopedCharBuffer utf8 = path.utf8_str();
    return std::string(utf8.data(), utf8.length());
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

bool MakeFolderWritable(wxString const& path)
{
    const std::string native = ToNativePath(path);
    struct stat info;
    if (native.empty() || lstat(native.c_str(), &info) != 0)
        return false;
    walkOk = true;
    // Pre-order, so a folder is opened up before its entries are visited.
    if (nftw(native.c_str(), MakeEntryWritable, kOpenDescriptors, FTW_PHYS) != 0)
        return false;
    return walkOk;
}

void DeleteFolderChildren(wxString const& folder)
{
    const std::string native = ToNativePath(folder);
    struct stat info;
    if (native.empty() || lstat(native.c_str(), &info) != 0)
        return;
    MakeFolderWritable(folder);
    posix::RemoveTree(native); // the folder itself too, despite the name
}
