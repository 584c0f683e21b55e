#include "core/DropCopy.h"

#include <cerrno>
#include <cstdio>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <wx/filename.h>
#include <wx/intl.h>

#include "folder/FileMoves.h"
#include "folder/HotFolder.h"
#include "posix/ErrorText.h"
#include "posix/NativePath.h"
#include "posix/UniqueFd.h"

namespace
{
// Enough names for a folder full of copies of one file.
const int kMaxAttempts = 10000;

wxString Reason(int error)
{
    return wxString::FromUTF8(posix::ErrorText(error).c_str());
}

bool CopyAll(int in, int out)
{
    char buffer[1 << 16];
    for (;;)
    {
        const ssize_t got = read(in, buffer, sizeof(buffer));
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
            const ssize_t put = write(out, buffer + written, got - written);
            if (put < 0 && errno != EINTR)
                return false;
            written += put < 0 ? 0 : put;
        }
    }
}

// The file's name as the folder gets it: a leading dot would hide it from
// the service for good.
wxString VisibleName(const wxString& file)
{
    wxString name = wxFileName(file).GetFullName();
    while (name.StartsWith("."))
        name.Remove(0, 1);
    return name;
}

// Copies in to a new hidden file in folder, on disk when this returns.
bool CopyToHidden(int in, const wxString& folder, std::string& hidden, wxString& error)
{
    hidden = posix::NativePath(folder) + "/.hf-drop-XXXXXX";
    const posix::UniqueFd out(mkostemp(&hidden[0], O_CLOEXEC));
    if (!out)
    {
        error =
            wxString::Format(_("Cannot write in %s: %s"), posix::ShownLine(folder), Reason(errno));
        hidden.clear();
        return false;
    }
    // As a file saved there by hand would be: readable by the service.
    if (fchmod(out.Get(), 0644) != 0 || !CopyAll(in, out.Get()) || fsync(out.Get()) != 0)
    {
        error =
            wxString::Format(_("Cannot copy into %s: %s"), posix::ShownLine(folder), Reason(errno));
        return false;
    }
    return true;
}
} // namespace

bool CopyIntoHotFolder(const wxString& file, const wxString& folder, wxString& copiedAs,
                       wxString& error)
{
    HotFolder hotFolder;
    wxString problem;
    if (!hotFolder.Open(folder, problem))
    {
        error = wxString::Format(_("%s is not a hot folder: %s"), posix::ShownLine(folder),
                                 posix::ShownLine(problem));
        return false;
    }
    const wxString name = VisibleName(file);
    const posix::UniqueFd in(open(posix::NativePath(file).c_str(), O_RDONLY | O_CLOEXEC));
    struct stat info;
    if (!in || fstat(in.Get(), &info) != 0)
    {
        error = wxString::Format(_("Cannot read %s: %s"), posix::ShownLine(file), Reason(errno));
        return false;
    }
    if (!S_ISREG(info.st_mode) || name.empty())
    {
        error =
            wxString::Format(_("%s is not a file that can be printed."), posix::ShownLine(file));
        return false;
    }
    std::string hidden;
    if (!CopyToHidden(in.Get(), hotFolder.GetFolder(), hidden, error))
    {
        if (!hidden.empty())
            unlink(hidden.c_str());
        return false;
    }
    for (int attempt = 1; attempt <= kMaxAttempts; ++attempt)
    {
        const wxString target =
            wxFileName(hotFolder.GetFolder(), NumberedName(name, attempt)).GetFullPath();
        // Never over a file waiting there: the next free variant instead.
        if (renameat2(AT_FDCWD, hidden.c_str(), AT_FDCWD, posix::NativePath(target).c_str(),
                      RENAME_NOREPLACE) == 0)
        {
            copiedAs = target;
            return true;
        }
        if (errno != EEXIST)
        {
            error = wxString::Format(_("Cannot put %s into %s: %s"), posix::ShownLine(name),
                                     posix::ShownLine(folder), Reason(errno));
            break;
        }
    }
    if (error.empty())
        error = wxString::Format(_("No free name for %s in %s."), posix::ShownLine(name),
                                 posix::ShownLine(folder));
    unlink(hidden.c_str());
    return false;
}
