// A trial conversion: one file run through the module with a folder's
// stored settings and server, as the service runs a job, but in a work
// folder of its own beside the output, so that the folder, its container
// and its logs never learn of it.
#include <sys/stat.h>

#include <memory>

#include <wx/filename.h>
#include <wx/intl.h>
#include <wx/log.h>

#include "folder/FileMoves.h"
#include "folder/HotFolder.h"
#include "folder/ServerDescription.h"
#include "jobs/JobExecution.h"
#include "module/FilterSession.h"
#include "module/ModuleLocator.h"
#include "posix/NativePath.h"
#include "preview/PagePreview.h"

namespace
{
bool IsRegularFile(const wxString& path)
{
    struct stat info;
    return stat(path.fn_str(), &info) == 0 && S_ISREG(info.st_mode);
}

bool SameFile(const wxString& a, const wxString& b)
{
    struct stat first, second;
    return stat(a.fn_str(), &first) == 0 && stat(b.fn_str(), &second) == 0 &&
           first.st_dev == second.st_dev && first.st_ino == second.st_ino;
}

// Where the output may go: a place the folder does not watch, and never
// over the input.
bool CheckPlaces(const HotFolder& folder, const wxFileName& eps, const wxFileName& output,
                 wxString& error)
{
    if (!IsRegularFile(eps.GetFullPath()))
    {
        error = wxString::Format(_("cannot find the file %s"), posix::ShownLine(eps.GetFullPath()));
        return false;
    }
    if (!wxFileName::DirExists(output.GetPath()))
    {
        error = wxString::Format(_("there is no folder %s"), posix::ShownLine(output.GetPath()));
        return false;
    }
    if (SameFile(eps.GetFullPath(), output.GetFullPath()))
    {
        error = _("the output would replace the file tried");
        return false;
    }
    if (wxFileName::DirName(output.GetPath()).SameAs(wxFileName::DirName(folder.GetFolder())))
    {
        error = _("a trial's output cannot go into the hot folder itself");
        return false;
    }
    return true;
}

// Runs the job in work and puts its output at target.
bool ConvertIn(FilterSession& session, const HotFolder& folder, const wxString& eps,
               const wxString& work, const wxString& target, wxString& error)
{
    wxArrayString files, second, rejected;
    files.Add(eps);
    JobInfoCollection jobs;
    session.Filter().SniffFiles(files, second, rejected, jobs);
    if (jobs.empty())
    {
        const wxString reason = session.RefusalReason(eps);
        error = wxString::Format(_("%s is not a file the %s filter accepts"),
                                 posix::ShownLine(wxFileName(eps).GetFullName()),
                                 session.Info().m_strDisplayName) +
                (reason.empty() ? wxString() : ": " + reason);
        return false;
    }
    // The job's overrides go into a copy of Folder.cfg, as in the service.
    if (!CopyFileTo(folder.GetConfigFile(), wxFileName(work, "Folder.cfg").GetFullPath(), error))
        return false;
    const JobOutput result = ProcessJob(session.Filter(), jobs[0], work, nullptr);
    if (result.status != 0 || result.producedPath.empty())
    {
        error = wxString::Format(_("cannot convert %s: %s"),
                                 posix::ShownLine(wxFileName(eps).GetFullName()),
                                 result.status != 0 ? session.DescribeStatus(result.status)
                                                    : _("the filter wrote no output"));
        return false;
    }
    wxString produced = result.producedPath;
    if (result.passThrough)
    {
        // The input itself is the output: a copy, never the file tried.
        produced = wxFileName(work, ".trial-output").GetFullPath();
        if (!CopyFileTo(result.producedPath, produced, error))
            return false;
    }
    if (!wxRenameFile(produced, target, true))
    {
        error = wxString::Format(_("cannot write %s"), posix::ShownLine(target));
        return false;
    }
    return true;
}
} // namespace

bool ConvertForTrial(const wxString& folderPath, const wxString& eps, const wxString& modulePath,
                     const wxString& outputPs, wxString& error)
{
    wxLogNull quiet; // reasons go back in error, never into a message box
    HotFolder folder;
    if (!folder.Open(folderPath, error))
        return false;
    wxFileName input(eps), output(outputPs);
    input.MakeAbsolute();
    output.MakeAbsolute();
    if (!CheckPlaces(folder, input, output, error))
        return false;
    ServerDescription server;
    if (wxFileName::FileExists(folder.GetServerDescriptionFile()) &&
        !server.Load(folder.GetServerDescriptionFile(), error))
        return false;
    std::unique_ptr<FilterSession> session = FilterSession::Start(
        LocateFilterModule(modulePath), server.GetText(), &folder.GetFilterSetting(), error);
    if (!session)
        return false;
    const wxString work = MakeUniqueDirectory(output.GetPath(), ".hotfolder-trial-", error);
    if (work.empty())
        return false;
    const bool converted =
        ConvertIn(*session, folder, input.GetFullPath(), work, output.GetFullPath(), error);
    RemoveTree(work);
    return converted;
}
