#include "posix/Directories.h"

#include <cerrno>
#include <ftw.h>
#include <sys/stat.h>
#include <unistd.h>

namespace posix
{
namespace
{
thread_local int firstRemoveError = 0;

int RemoveEntry(const char* path, const struct stat*, int type, struct FTW*)
{
    const bool directory = type == FTW_DP || type == FTW_D || type == FTW_DNR;
    if ((directory ? ::rmdir(path) : ::unlink(path)) != 0 && firstRemoveError == 0)
        firstRemoveError = errno;
    return 0; // on with the rest
}

// Enough for deep trees without running into the descriptor limit.
constexpr int kOpenDescriptors = 32;
} // namespace

int MakeDirectory(const std::string& path, mode_t mode, DirectoryMode how)
{
    if (::mkdir(path.c_str(), mode) != 0)
        return errno;
    if (how == DirectoryMode::Exact)
        ::chmod(path.c_str(), mode);
    return 0;
}

int MakeDirectories(const std::string& path, mode_t mode, DirectoryMode how)
{
    std::string whole = path;
    while (whole.size() > 1 && whole.back() == '/')
        whole.pop_back();
    for (size_t slash = 1; slash <= whole.size(); ++slash)
    {
        if (slash != whole.size() && whole[slash] != '/')
            continue;
        const int error = MakeDirectory(whole.substr(0, slash), mode, how);
        if (error != 0 && error != EEXIST)
            return error;
    }
    struct stat info;
    return ::stat(whole.c_str(), &info) == 0 && S_ISDIR(info.st_mode) ? 0 : ENOTDIR;
}

int RemoveTree(const std::string& path)
{
    firstRemoveError = 0;
    // Post-order: entries go before the directories that hold them.
    if (::nftw(path.c_str(), RemoveEntry, kOpenDescriptors, FTW_DEPTH | FTW_PHYS) != 0)
        return firstRemoveError != 0 ? firstRemoveError : errno;
    return firstRemoveError;
}
} // namespace posix
