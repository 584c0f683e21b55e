#include "folder/FileMoves.h"

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <fcntl.h>
#include <ftw.h>
#include <sys/stat.h>
#include <unistd.h>

#include <wx/filename.h>

static std::string Native(const wxString& path)
{
    return std::string(path.fn_str());
}

static wxString Reason(int error)
{
    return wxString::FromUTF8(std::strerror(error));
}

wxString NumberedName(const wxString& name, int attempt)
{
    if (attempt <= 1)
        return name;
    wxFileName parts(name);
    wxString numbered = wxString::Format("%s (%d)", parts.GetName(), attempt);
    if (parts.HasExt())
        numbered << "." << parts.GetExt();
    return numbered;
}

static bool CopyBytes(int in, int out)
{
    char buffer[1 << 16];
    for (;;)
    {
        ssize_t got = read(in, buffer, sizeof(buffer));
        if (got == 0)
            return true;
        if (got < 0)
        {
            if (errno == EINTR)
                continue;
            return false;
        }
        for (ssize_t written = 0; written < got;)
        {
            ssize_t put = write(out, buffer + written, got - written);
            if (put < 0)
            {
                if (errno == EINTR)
                    continue;
                return false;
            }
            written += put;
        }
    }
}

bool CopyFileTo(const wxString& file, const wxString& target, wxString& error, bool sync)
{
    int in = open(Native(file).c_str(), O_RDONLY | O_CLOEXEC);
    if (in < 0)
    {
        error = wxString::Format("cannot read %s: %s", file, Reason(errno));
        return false;
    }
    int out = open(Native(target).c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
    if (out < 0)
    {
        error = wxString::Format("cannot create %s: %s", target, Reason(errno));
        close(in);
        return false;
    }
    bool copied = CopyBytes(in, out) && (!sync || fsync(out) == 0);
    int saved = errno;
    close(in);
    if (close(out) != 0)
        copied = false;
    if (!copied)
    {
        unlink(Native(target).c_str());
        error = wxString::Format("cannot copy %s to %s: %s", file, target, Reason(saved));
    }
    return copied;
}

// Moves without replacing: the kernel refuses when the target exists.
static int RenameNoReplace(const std::string& from, const std::string& to)
{
    return renameat2(AT_FDCWD, from.c_str(), AT_FDCWD, to.c_str(), RENAME_NOREPLACE);
}

// Across file systems: a private copy in the target directory, then a link
// under the final name (fails rather than replaces), then the source goes.
static bool MoveByCopy(const wxString& file, const wxString& directory, const wxString& name,
                       wxString& finalPath, wxString& error)
{
    wxString temporary = wxFileName(directory, ".hotfolder-move-" + name).GetFullPath();
    unlink(Native(temporary).c_str());
    if (!CopyFileTo(file, temporary, error, true)) // the source is unlinked next
        return false;
    for (int attempt = 1; attempt < 10000; ++attempt)
    {
        wxString target = wxFileName(directory, NumberedName(name, attempt)).GetFullPath();
        if (link(Native(temporary).c_str(), Native(target).c_str()) == 0)
        {
            unlink(Native(temporary).c_str());
            if (unlink(Native(file).c_str()) != 0 && errno != ENOENT)
            {
                error = wxString::Format("copied %s to %s but cannot remove it: %s", file, target,
                                         Reason(errno));
                finalPath = target;
                return false;
            }
            finalPath = target;
            return true;
        }
        if (errno != EEXIST)
            break;
    }
    error = wxString::Format("cannot move %s into %s: %s", file, directory, Reason(errno));
    unlink(Native(temporary).c_str());
    return false;
}

bool MoveIntoDirectory(const wxString& file, const wxString& directory, const wxString& name,
                       wxString& finalPath, wxString& error)
{
    for (int attempt = 1; attempt < 10000; ++attempt)
    {
        wxString target = wxFileName(directory, NumberedName(name, attempt)).GetFullPath();
        if (RenameNoReplace(Native(file), Native(target)) == 0)
        {
            finalPath = target;
            return true;
        }
        if (errno == EEXIST)
            continue;
        if (errno == EXDEV)
            return MoveByCopy(file, directory, name, finalPath, error);
        error = wxString::Format("cannot move %s into %s: %s", file, directory, Reason(errno));
        return false;
    }
    error = wxString::Format("cannot find a free name for %s in %s", name, directory);
    return false;
}

bool MakeDirectories(const wxString& directory, wxString& error)
{
    std::string path = Native(directory);
    while (path.size() > 1 && path.back() == '/')
        path.pop_back();
    for (size_t slash = 1; slash <= path.size(); ++slash)
    {
        if (slash != path.size() && path[slash] != '/')
            continue;
        std::string prefix = path.substr(0, slash);
        if (mkdir(prefix.c_str(), 0777) != 0 && errno != EEXIST)
        {
            error =
                wxString::Format("cannot create the directory %s: %s", directory, Reason(errno));
            return false;
        }
    }
    struct stat info;
    if (stat(path.c_str(), &info) != 0 || !S_ISDIR(info.st_mode))
    {
        error = wxString::Format("%s is not a directory", directory);
        return false;
    }
    return true;
}

bool EnsureWritableDirectory(const wxString& directory, wxString& error)
{
    if (!MakeDirectories(directory, error))
        return false;
    wxString probe =
        wxFileName(directory, wxString::Format(".hotfolder-probe-%d", getpid())).GetFullPath();
    int fd = open(Native(probe).c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0600);
    if (fd < 0)
    {
        error =
            wxString::Format("cannot write into the directory %s: %s", directory, Reason(errno));
        return false;
    }
    close(fd);
    unlink(Native(probe).c_str());
    return true;
}

static int RemoveEntry(const char* path, const struct stat*, int type, struct FTW*)
{
    return type == FTW_DP ? rmdir(path) : unlink(path);
}

bool RemoveTree(const wxString& directory)
{
    return nftw(Native(directory).c_str(), RemoveEntry, 16, FTW_DEPTH | FTW_PHYS) == 0;
}
