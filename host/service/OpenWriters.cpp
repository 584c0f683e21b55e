#include "service/OpenWriters.h"

#include <cctype>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <dirent.h>
#include <fcntl.h>
#include <string>
#include <sys/stat.h>
#include <unistd.h>

// Why a scan of /proc and not a file lease: a lease may be taken only by the
// file's owner or with CAP_LEASE, is refused on some file systems (and on
// overlay mounts in older kernels), and breaking one would stall the writer.
// The scan sees every writer on this machine that the service may inspect;
// run as the system service (root) that is every local process. A writer on
// another machine (network file systems) is invisible to both; for those the
// settle time stays the fallback. The scan is one pass for a whole batch of
// candidates, so a burst costs one walk of /proc, not one per file.

static bool OpenForWriting(int fdinfoDirectory, const char* fdName)
{
    int fd = openat(fdinfoDirectory, fdName, O_RDONLY | O_CLOEXEC);
    if (fd < 0)
        return false;
    char text[512];
    ssize_t got = read(fd, text, sizeof(text) - 1);
    close(fd);
    if (got <= 0)
        return false;
    text[got] = '\0';
    const char* flags = std::strstr(text, "flags:");
    if (!flags)
        return false;
    long value = std::strtol(flags + 6, nullptr, 8); // printed in octal
    int access = static_cast<int>(value) & O_ACCMODE;
    return access == O_WRONLY || access == O_RDWR;
}

std::set<FileIdentity> FindFilesOpenForWriting(const std::set<FileIdentity>& files)
{
    std::set<FileIdentity> writing;
    if (files.empty())
        return writing;
    DIR* processes = opendir("/proc");
    if (!processes)
        return writing;
    const pid_t self = getpid();
    while (struct dirent* process = readdir(processes))
    {
        if (!std::isdigit(static_cast<unsigned char>(process->d_name[0])) ||
            std::atoi(process->d_name) == self)
            continue;
        std::string base = std::string("/proc/") + process->d_name;
        int fdDirectory = open((base + "/fd").c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
        if (fdDirectory < 0)
            continue; // gone, or not ours to see
        DIR* descriptors = fdopendir(fdDirectory);
        if (!descriptors)
        {
            close(fdDirectory);
            continue;
        }
        int fdinfoDirectory = -1;
        while (struct dirent* descriptor = readdir(descriptors))
        {
            if (descriptor->d_name[0] == '.')
                continue;
            struct stat info;
            // Follows the descriptor's link to the open file itself.
            if (fstatat(fdDirectory, descriptor->d_name, &info, 0) != 0 || !S_ISREG(info.st_mode))
                continue;
            FileIdentity identity(info.st_dev, info.st_ino);
            if (!files.count(identity) || writing.count(identity))
                continue;
            if (fdinfoDirectory < 0)
                fdinfoDirectory =
                    open((base + "/fdinfo").c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
            if (fdinfoDirectory >= 0 && OpenForWriting(fdinfoDirectory, descriptor->d_name))
                writing.insert(identity);
        }
        if (fdinfoDirectory >= 0)
            close(fdinfoDirectory);
        closedir(descriptors);
    }
    closedir(processes);
    return writing;
}
