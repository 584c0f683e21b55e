#pragma once
// Directory trees through system calls only: no path ever reaches a shell.
#include <string>
#include <sys/types.h>

namespace posix
{
// How a new directory's mode is set.
enum class DirectoryMode
{
    LessUmask, // as mkdir does
    Exact,     // whatever the umask: for directories every user shares
};

// Creates the directory and any missing parents. Returns 0 when the path is
// a directory afterwards, else the errno of the mkdir that failed, or
// ENOTDIR when the path then names anything but a directory (or nothing).
int MakeDirectories(const std::string& path, mode_t mode,
                    DirectoryMode how = DirectoryMode::LessUmask);

// Creates one directory, parents not included. Returns 0 when it was made,
// else mkdir's errno (EEXIST when something is there already).
int MakeDirectory(const std::string& path, mode_t mode,
                  DirectoryMode how = DirectoryMode::LessUmask);

// Removes the path and everything below it; symbolic links are removed,
// never followed. Goes on past entries it cannot remove and returns the
// errno of the first failure, or 0.
int RemoveTree(const std::string& path);
} // namespace posix
