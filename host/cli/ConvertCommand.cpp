// hotfolder convert: one file through the filter, outside any hot folder.
#include <cerrno>
#include <cstring>
#include <memory>
#include <sys/stat.h>
#include <unistd.h>

#include <wx/filename.h>
#include <wx/log.h>
#include <wx/xml/xml.h>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "folder/FileMoves.h"
#include "module/FilterSession.h"
#include "module/FilterSettings.h"
#include "jobs/JobExecution.h"
#include "module/ModuleLocator.h"
#include "cli/ProgressDisplay.h"
#include "folder/ServerDescription.h"
#include "folder/ServerPapers.h"
#include "SettingsKeys.h"

static const char kConvertUsage[] =
    "usage: hotfolder convert IN.eps [-o OUT.ps] [--force] [--server FILE]\n"
    "                         [--set KEY=VALUE ...] [--module PATH]\n"
    "\n"
    "Converts one EPS file to PostScript with the filter's default settings,\n"
    "changed by --set (see 'hotfolder settings --help' for the keys). OUT.ps\n"
    "defaults to IN with the extension .ps, next to it. With --server the\n"
    "filter learns the server's papers; DEFAULTPAGESIZE=<paper> then also sets\n"
    "that paper's size and imageable area, and without it the server's default\n"
    "paper is used. Without a paper the page takes the artwork's own size.\n"
    "An existing OUT.ps is left alone unless --force says to replace it.\n";

// Anything under the name, a dangling link too.
static bool Exists(const wxString& path)
{
    struct stat info;
    return lstat(path.fn_str(), &info) == 0;
}

static bool SameFile(const wxString& a, const wxString& b)
{
    struct stat first, second;
    return stat(a.fn_str(), &first) == 0 && stat(b.fn_str(), &second) == 0 &&
           first.st_dev == second.st_dev && first.st_ino == second.st_ino;
}

int RunConvertCommand(const Arguments& args)
{
    ParsedArgs parsed;
    int status = 0;
    if (!ParseCommandLine(args,
                          {{"--output", true, false, "-o"},
                           {"--force", false, false, ""},
                           {"--server", true, false, ""},
                           {"--set", false, true, ""}},
                          kConvertUsage, 1, 1, parsed, status))
        return status;

    wxFileName input(FromUtf8(parsed.positionals[0]));
    input.MakeAbsolute();
    struct stat inputInfo;
    if (stat(input.GetFullPath().fn_str(), &inputInfo) != 0 || !S_ISREG(inputInfo.st_mode))
    {
        PrintError("cannot find the input file " + input.GetFullPath());
        return kExitSetupFailed;
    }
    wxFileName output(FromUtf8(parsed.Get("--output")));
    if (!parsed.Has("--output"))
        output = wxFileName(input.GetPath(), input.GetName() + ".ps");
    output.MakeAbsolute();
    if (SameFile(input.GetFullPath(), output.GetFullPath()))
    {
        PrintError("the output would replace the input " + input.GetFullPath());
        return kExitUsage;
    }
    const bool replace = parsed.Has("--force");
    if (!replace && Exists(output.GetFullPath()))
    {
        PrintError(output.GetFullPath() + " exists already; --force replaces it");
        return kExitUsage;
    }

    ServerDescription server;
    wxString error;
    if (parsed.Has("--server") && !server.Load(FromUtf8(parsed.Get("--server")), error))
    {
        PrintError(error);
        return kExitSetupFailed;
    }

    const wxString modulePath = LocateFilterModule(FromUtf8(parsed.Get("--module")));
    std::unique_ptr<wxXmlNode> filterNode(MakeDefaultFilterNode(modulePath, error));
    if (!filterNode)
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    // PostScript is what this command is for; --set may still ask otherwise.
    std::vector<std::string> assignments = {"OUTPUTFILETYPEEPS=0", "OUTPUTFILETYPEPS=1"};
    ServerPapers papers;
    if (!server.IsEmpty())
    {
        papers.Load(server.GetText());
        if (!papers.defaultPaper.empty())
            assignments.push_back("DEFAULTPAGESIZE=" + ToUtf8(papers.defaultPaper));
    }
    for (const std::string& assignment : parsed.All("--set"))
        assignments.push_back(assignment);
    if (!ApplySettingAssignments(filterNode.get(), assignments, papers.sheets, error))
    {
        PrintError(error);
        return kExitUsage;
    }

    wxXmlNode filterSetting(wxXML_ELEMENT_NODE, "FilterSetting");
    filterSetting.AddChild(filterNode.release());
    std::unique_ptr<FilterSession> session =
        FilterSession::Start(modulePath, server.GetText(), &filterSetting, error);
    if (!session)
    {
        PrintError(error);
        return kExitSetupFailed;
    }

    wxArrayString files, second, rejected;
    files.Add(input.GetFullPath());
    JobInfoCollection jobs;
    session->Filter().SniffFiles(files, second, rejected, jobs);
    if (jobs.empty())
    {
        const wxString reason = session->RefusalReason(input.GetFullPath());
        PrintError(input.GetFullPath() + " is not a file the " + session->Info().m_strDisplayName +
                   " filter accepts" + (reason.empty() ? wxString() : ": " + reason));
        return kExitJobsFailed;
    }

    wxString workDirectory = MakeUniqueDirectory(output.GetPath(), ".hotfolder-convert-", error);
    if (workDirectory.empty())
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    ProgressDisplay progress(StdoutIsTerminal());
    progress.BeginJob(0, 1, input.GetFullName());
    JobOutput result = ProcessJob(session->Filter(), jobs[0], workDirectory, &progress);
    int exitStatus = kExitSuccess;
    if (result.status != 0 || result.producedPath.empty())
    {
        progress.Note(input.GetFullName() + ": failed");
        PrintError(wxString::Format("cannot convert %s: %s", input.GetFullPath(),
                                    result.status != 0 ? session->DescribeStatus(result.status)
                                                       : wxString("the filter wrote no output")));
        exitStatus = kExitJobsFailed;
    }
    else
    {
        wxString target = output.GetFullPath();
        wxString produced = result.producedPath;
        bool delivered = true;
        if (result.passThrough)
        {
            // The input itself is the output: deliver a copy, never the original.
            produced = wxFileName(workDirectory, result.outputName).GetFullPath();
            delivered = CopyFileTo(result.producedPath, produced, error);
        }
        wxLogNull quiet;
        // Without --force a file that appeared meanwhile is kept: link()
        // refuses an existing name, where a rename would replace it.
        if (delivered && !replace && link(produced.fn_str(), target.fn_str()) != 0)
        {
            delivered = false;
            error = errno == EEXIST ? target + " exists already; --force replaces it"
                                    : "cannot write " + target + ": " + FromUtf8(strerror(errno));
        }
        else if (delivered)
            delivered = replace ? wxRenameFile(produced, target, true) : true;
        if (!delivered)
        {
            if (error.empty())
                error = "cannot write " + target;
            PrintError(error);
            exitStatus = kExitJobsFailed;
        }
        else
            progress.EndJob(input.GetFullPath() + " -> " + target);
    }
    RemoveTree(workDirectory);
    return exitStatus;
}
