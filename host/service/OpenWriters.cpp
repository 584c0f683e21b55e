#include "service/OpenWriters.h"

#include <cctype>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <dirent.h>
#include <csignal>
#include <fcntl.h>
#include <string>
#include <sys/stat.h>
#include <unistd.h>

// First a read lease: the kernel refuses one while any descriptor of the
// file, whoever holds it, is open for writing, so it sees a writer of
// another user (a file share writes as the connected user) without the
// right to look into other users' processes. Taking it needs the file's
// owner or CAP_LEASE, which the service keeps for this. The lease is given
// back at once; a writer that opens the file meanwhile waits that long, and
// the break signal it would send is ignored.
// Where no lease can be taken (file systems without leases, a caller that
// neither owns the file nor has CAP_LEASE), a scan of /proc: it sees the
// writers among the processes the caller may inspect, one pass for a whole
// batch. A writer on another machine (network file systems) is invisible to
// both; for those the settle time stays the fallback.
namespace
{
enum class Writers
{
    None,
    Some,
    Unknown
};

Writers ProbeByLease(const std::string& path, const FileIdentity& identity)
{
    static const bool breakSignalIgnored = (signal(SIGIO, SIG_IGN), true);
    (void)breakSignalIgnored;
    // Never follows a link, never waits on a FIFO, never becomes a terminal.
    const int fd = open(path.c_str(), O_RDONLY | O_NONBLOCK | O_NOFOLLOW | O_NOCTTY | O_CLOEXEC);
    if (fd < 0)
        return Writers::Unknown;
    struct stat info;
    Writers writers = Writers::Unknown;
    if (fstat(fd, &info) == 0 && S_ISREG(info.st_mode) &&
        FileIdentity(info.st_dev, info.st_ino) == identity)
    {
        if (fcntl(fd, F_SETLEASE, F_RDLCK) == 0)
        {
            fcntl(fd, F_SETLEASE, F_UNLCK);
            writers = Writers::None;
        }
        else if (errno == EAGAIN)
            writers = Writers::Some;
    }
    close(fd);
    return writers;
}
} // namespace

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

static std::set<FileIdentity> ScanForWriters(const std::set<FileIdentity>& files)
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

std::set<FileIdentity> FindFilesOpenForWriting(const std::map<FileIdentity, std::string>& files)
{
    std::set<FileIdentity> writing, unknown;
    for (const auto& [identity, path] : files)
        switch (ProbeByLease(path, identity))
        {
        case Writers::Some:
            writing.insert(identity);
            break;
        case Writers::Unknown:
            unknown.insert(identity);
            break;
        case Writers::None:
            break;
        }
    for (const FileIdentity& identity : ScanForWriters(unknown))
        writing.insert(identity);
    return writing;
}
