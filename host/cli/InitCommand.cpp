// hotfolder init: makes a folder a hot folder.
#include <cstdio>
#include <string>
#include <vector>

#include <wx/filename.h>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "cli/FolderCreation.h"
#include "module/ModuleLocator.h"

static const char kInitUsage[] =
    "usage: hotfolder init FOLDER [--server FILE | --ppd FILE.ppd | --printer QUEUE]\n"
    "                             [--name NAME] [--module PATH]\n"
    "\n"
    "Makes FOLDER (created when missing) a hot folder: its container\n"
    "\"[_Orv_HotFolder_]\" with Folder.cfg (name, work, failed and kept-originals\n"
    "folders, the filter's default settings), a copy of the server description\n"
    "FILE beside it, and an entry in the machine-wide hot-folder list.\n"
    "NAME defaults to the folder's own name.\n"
    "\n"
    "--ppd FILE.ppd makes the server description from a printer's PPD file\n"
    "(its papers, default paper and custom size limits) and keeps a copy of\n"
    "the PPD as server.ppd beside it.\n"
    "\n"
    "--printer QUEUE does the same with the description of the CUPS queue\n"
    "QUEUE (of the scheduler CUPS_SERVER or client.conf names) and binds the\n"
    "folder to it: the service and 'hotfolder run' print there. 'hotfolder\n"
    "settings FOLDER --printer' binds it to another queue or to none.\n";

namespace
{
bool ParseInitRequest(const Arguments& args, FolderCreationRequest& request, int& status)
{
    ParsedArgs parsed;
    if (!ParseCommandLine(args,
                          {{"--server", true, false, ""},
                           {"--ppd", true, false, ""},
                           {"--printer", true, false, ""},
                           {"--name", true, false, ""}},
                          kInitUsage, 1, 1, parsed, status))
        return false;
    const int sources = parsed.Has("--server") + parsed.Has("--ppd") + parsed.Has("--printer");
    if (sources > 1)
    {
        PrintError(parsed.Has("--printer")
                       ? "only one of --server, --ppd and --printer can be given"
                       : "--server and --ppd cannot be given together");
        std::fputs(kInitUsage, stderr);
        status = kExitUsage;
        return false;
    }
    wxFileName folderName = wxFileName::DirName(FromUtf8(parsed.positionals[0]));
    folderName.MakeAbsolute();
    request.folder = folderName.GetPath();
    request.serverFile = parsed.Get("--server");
    request.ppdFile = parsed.Get("--ppd");
    request.queue = parsed.Get("--printer");
    request.name = FromUtf8(parsed.Get("--name"));
    request.modulePath = LocateFilterModule(FromUtf8(parsed.Get("--module")));
    return true;
}
} // namespace

int RunInitCommand(const Arguments& args)
{
    FolderCreationRequest request;
    int status = kExitSuccess;
    if (!ParseInitRequest(args, request, status))
        return status;
    FolderCreationPlan plan;
    wxString error;
    if (!PlanFolderCreation(request, plan, error))
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    std::vector<wxString> warnings;
    const bool created = CreatePlannedFolder(request, plan, warnings, error);
    for (const wxString& warning : warnings)
        PrintError("warning: " + warning);
    if (!created)
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    PrintLine("Hot folder:     " + request.folder);
    PrintLine("Configuration:  " + plan.configFile);
    PrintLine("Filter:         " + plan.info.m_strIdentifier);
    PrintLine("Server:         " + (plan.server.IsEmpty() ? wxString("(none)") : plan.origin));
    return kExitSuccess;
}
