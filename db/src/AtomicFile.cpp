#include "db/AtomicFile.h"

#include <cerrno>
#include <climits>
#include <cstdlib>
#include <ctime>
#include <string>

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <wx/mstream.h>

#include "posix/ErrorText.h"
#include "posix/PathNames.h"
#include "posix/UniqueDir.h"
#include "posix/UniqueFd.h"

namespace
{
bool WriteAll(int fd, const char* data, size_t size)
{
    while (size > 0)
    {
        const ssize_t written = ::write(fd, data, size);
        if (written < 0)
        {
            if (errno == EINTR)
                continue;
            return false;
        }
        data += written;
        size -= static_cast<size_t>(written);
    }
    return true;
}

// A symbolic link is followed, so the file it names is replaced rather than
// the link itself.
std::string ResolveTarget(const std::string& path)
{
    struct stat info;
    if (::lstat(path.c_str(), &info) == 0 && S_ISLNK(info.st_mode))
    {
        char resolved[PATH_MAX];
        if (::realpath(path.c_str(), resolved))
            return resolved;
    }
    return path;
}

// O_EXCL with a fresh random suffix: the temp file is ours alone, and its
// mode is 0666 less the umask like any newly created file.
posix::UniqueFd CreateTempBeside(const std::string& target, std::string& tempPath)
{
    const std::string directory = posix::DirectoryName(target);
    const std::string base = posix::BaseName(target);
    static thread_local unsigned seed =
        static_cast<unsigned>(::getpid()) ^ static_cast<unsigned>(::time(nullptr));
    for (int attempt = 0; attempt < 100; ++attempt)
    {
        char suffix[16];
        // A forked child inherits the seed; mixing in the current pid keeps
        // parent and child from trying the same names in lockstep.
        const unsigned mixed = static_cast<unsigned>(rand_r(&seed)) ^
                               (static_cast<unsigned>(::getpid()) * 2654435761u);
        snprintf(suffix, sizeof suffix, ".%08x", mixed);
        tempPath = directory + "/." + base + suffix + ".tmp";
        posix::UniqueFd fd(::open(tempPath.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666));
        if (fd || errno != EEXIST)
            return fd;
    }
    return posix::UniqueFd();
}

// XML 1.0 has no way to carry most C0 controls, U+FFFE, U+FFFF or surrogate
// code points, and wxXmlDocument writes them raw; a file holding one would
// never load again. In UTF-8 the controls are single bytes that never occur
// inside a multi-byte sequence, so they can be dropped byte by byte.
void DropCharactersXmlCannotHold(std::string& bytes)
{
    std::string kept;
    kept.reserve(bytes.size());
    for (size_t i = 0; i < bytes.size(); ++i)
    {
        const unsigned char c = static_cast<unsigned char>(bytes[i]);
        if (c < 0x20 && c != '\t' && c != '\n' && c != '\r')
            continue;
        if (i + 2 < bytes.size())
        {
            const unsigned char c1 = static_cast<unsigned char>(bytes[i + 1]);
            const unsigned char c2 = static_cast<unsigned char>(bytes[i + 2]);
            const bool nonCharacter = c == 0xEF && c1 == 0xBF && (c2 == 0xBE || c2 == 0xBF);
            const bool surrogate = c == 0xED && c1 >= 0xA0;
            if (nonCharacter || surrogate)
            {
                i += 2;
                continue;
            }
        }
        kept.push_back(static_cast<char>(c));
    }
    bytes.swap(kept);
}

// Temp files of writers that were killed before their rename. Only those
// untouched for a long time go: a live writer's file is never that old.
void RemoveStaleTempFiles(const std::string& directory, const std::string& base)
{
    const std::string prefix = "." + base + ".";
    const size_t expectedLength = prefix.size() + 8 + 4; // 8 hex digits, ".tmp"
    posix::UniqueDir dir(directory.c_str());
    if (!dir)
        return;
    const time_t cutoff = ::time(nullptr) - 15 * 60;
    while (const dirent* entry = dir.Next())
    {
        const std::string name = entry->d_name;
        if (name.size() != expectedLength || name.compare(0, prefix.size(), prefix) != 0 ||
            name.compare(name.size() - 4, 4, ".tmp") != 0)
            continue;
        const std::string path = directory + "/" + name;
        struct stat info;
        if (::lstat(path.c_str(), &info) == 0 && S_ISREG(info.st_mode) && info.st_mtime < cutoff)
            ::unlink(path.c_str());
    }
}

void SyncDirectory(const std::string& directory)
{
    const posix::UniqueFd fd(::open(directory.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (fd)
        ::fsync(fd.Get());
}

bool Failed(wxString* reason, int error)
{
    if (reason)
        *reason = wxString::FromUTF8(posix::ErrorText(error).c_str());
    return false;
}
} // namespace

namespace db
{
bool AtomicFile::Write(const wxString& path, const void* data, size_t size, wxString* reason)
{
    if (path.empty())
        return Failed(reason, ENOENT);
    const std::string target = ResolveTarget(std::string(path.fn_str()));
    std::string tempPath;
    posix::UniqueFd fd = CreateTempBeside(target, tempPath);
    if (!fd)
        return Failed(reason, errno);

    // The replacement keeps the permissions (and, for root, the owner) of
    // the file it replaces: the file is shared by every user of the folder.
    struct stat old;
    if (::stat(target.c_str(), &old) == 0 && S_ISREG(old.st_mode))
    {
        ::fchmod(fd.Get(), old.st_mode & 07777);
        if (::geteuid() == 0)
            (void)!::fchown(fd.Get(), old.st_uid, old.st_gid);
    }

    bool ok = WriteAll(fd.Get(), static_cast<const char*>(data), size) && ::fsync(fd.Get()) == 0;
    int error = ok ? 0 : errno;
    if (!fd.Close() && ok)
    {
        ok = false;
        error = errno;
    }
    if (ok && ::rename(tempPath.c_str(), target.c_str()) != 0)
    {
        ok = false;
        error = errno;
    }
    if (!ok)
    {
        ::unlink(tempPath.c_str());
        return Failed(reason, error);
    }
    const std::string directory = posix::DirectoryName(target);
    SyncDirectory(directory);
    RemoveStaleTempFiles(directory, posix::BaseName(target));
    return true;
}

bool AtomicFile::Write(const wxString& path, const std::string& bytes, wxString* reason)
{
    return Write(path, bytes.data(), bytes.size(), reason);
}

bool AtomicFile::WriteXml(const wxString& path, const wxXmlDocument& document, int indent)
{
    if (!document.IsOk())
        return false;
    wxMemoryOutputStream stream;
    if (!document.Save(stream, indent))
        return false;
    const size_t length = static_cast<size_t>(stream.GetLength());
    std::string bytes(length, '\0');
    if (length > 0)
        stream.CopyTo(&bytes[0], length);
    DropCharactersXmlCannotHold(bytes);
    return Write(path, bytes);
}
} // namespace db
