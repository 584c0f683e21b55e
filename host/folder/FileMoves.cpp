#include "folder/FileMoves.h"

#include <cerrno>
#include <cstdio>
#include <fcntl.h>
#include <unistd.h>

#include <wx/filename.h>

#include "posix/Directories.h"
#include "posix/ErrorText.h"
#include "posix/NativePath.h"
#include "posix/UniqueFd.h"

using posix::NativePath;

static wxString Reason(int error)
{
    return wxString::FromUTF8(posix::ErrorText(error).c_str());
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
    posix::UniqueFd in(open(NativePath(file).c_str(), O_RDONLY | O_CLOEXEC));
    if (!in)
    {
        error = wxString::Format("cannot read %s: %s", file, Reason(errno));
        return false;
    }
    posix::UniqueFd out(
        open(NativePath(target).c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666));
    if (!out)
    {
        error = wxString::Format("cannot create %s: %s", target, Reason(errno));
        return false;
    }
    bool copied = CopyBytes(in.Get(), out.Get()) && (!sync || fsync(out.Get()) == 0);
    int saved = errno;
    in.Reset();
    if (!out.Close())
        copied = false;
    if (!copied)
    {
        unlink(NativePath(target).c_str());
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
    unlink(NativePath(temporary).c_str());
    if (!CopyFileTo(file, temporary, error, true)) // the source is unlinked next
        return false;
    for (int attempt = 1; attempt < 10000; ++attempt)
    {
        wxString target = wxFileName(directory, NumberedName(name, attempt)).GetFullPath();
        if (link(NativePath(temporary).c_str(), NativePath(target).c_str()) == 0)
        {
            unlink(NativePath(temporary).c_str());
            if (unlink(NativePath(file).c_str()) != 0 && errno != ENOENT)
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
    unlink(NativePath(temporary).c_str());
    return false;
}

bool MoveIntoDirectory(const wxString& file, const wxString& directory, const wxString& name,
                       wxString& finalPath, wxString& error)
{
    for (int attempt = 1; attempt < 10000; ++attempt)
    {
        wxString target = wxFileName(directory, NumberedName(name, attempt)).GetFullPath();
        if (RenameNoReplace(NativePath(file), NativePath(target)) == 0)
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
    const int failure = posix::MakeDirectories(NativePath(directory), 0777);
    if (failure == ENOTDIR)
        error = wxString::Format("%s is not a directory", directory);
    else if (failure != 0)
        error = wxString::Format("cannot create the directory %s: %s", directory, Reason(failure));
    return failure == 0;
}

bool EnsureWritableDirectory(const wxString& directory, wxString& error)
{
    if (!MakeDirectories(directory, error))
        return false;
    wxString probe =
        wxFileName(directory, wxString::Format(".hotfolder-probe-%d", getpid())).GetFullPath();
    const posix::UniqueFd fd(
        open(NativePath(probe).c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0600));
    if (!fd)
    {
        error =
            wxString::Format("cannot write into the directory %s: %s", directory, Reason(errno));
        return false;
    }
    unlink(NativePath(probe).c_str());
    return true;
}

bool RemoveTree(const wxString& directory)
{
    return posix::RemoveTree(NativePath(directory)) == 0;
}
