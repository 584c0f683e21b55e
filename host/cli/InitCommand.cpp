// hotfolder init: makes a folder a hot folder.
#include <cstdio>
#include <memory>
#include <string>

#include <wx/filename.h>
#include <wx/xml/xml.h>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "service/FolderAccess.h"
#include "cli/QueueBinding.h"
#include "cli/ServerBinding.h"
#include "folder/FileMoves.h"
#include "module/FilterSession.h"
#include "folder/HotFolder.h"
#include "module/ModuleLocator.h"
#include "folder/ServerDescription.h"
#include "db/AtomicFile.h"
#include "db/HFDatabase.h"
#include "db/PathResolver.h"

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
// What the command line asks for.
struct InitRequest
{
    wxFileName folderName; // absolute
    wxString folder;
    std::string serverFile;
    std::string ppdFile;
    std::string queue;
    std::string name;
    std::string module;
};

// Everything read and checked before anything is made.
struct InitPlan
{
    ServerDescription server;
    std::string ppdBytes; // the printer description to keep beside it, if any
    wxString origin;      // where the server description came from
    wxString configFile;
    PluginInfo info;
    std::unique_ptr<wxXmlNode> filter;
};

bool IsListed(const wxString& folder)
{
    wxArrayString folders;
    db::HFDatabase::ReadFoldersList(folders);
    for (const wxString& listed : folders)
        if (wxFileName::DirName(listed).SameAs(wxFileName::DirName(folder)))
            return true;
    return false;
}

bool ParseInitRequest(const Arguments& args, InitRequest& request, int& status)
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
    request.folderName = wxFileName::DirName(FromUtf8(parsed.positionals[0]));
    request.folderName.MakeAbsolute();
    request.folder = request.folderName.GetPath();
    request.serverFile = parsed.Get("--server");
    request.ppdFile = parsed.Get("--ppd");
    request.queue = parsed.Get("--printer");
    request.name = parsed.Get("--name");
    request.module = parsed.Get("--module");
    return true;
}

// Reads the server description, checks the folder is not one already and
// loads the module's defaults. False after printing the reason.
bool PrepareInit(const InitRequest& request, InitPlan& plan)
{
    wxString error;
    bool loaded = true;
    if (!request.serverFile.empty())
    {
        plan.origin = FromUtf8(request.serverFile);
        loaded = plan.server.Load(plan.origin, error);
    }
    else if (!request.ppdFile.empty())
    {
        plan.origin = FromUtf8(request.ppdFile);
        loaded = LoadPpdServer(request.ppdFile, plan.server, plan.ppdBytes, error);
    }
    else if (!request.queue.empty())
        loaded = LoadQueueServer(request.queue, plan.server, plan.ppdBytes, plan.origin, error);
    if (!loaded)
    {
        PrintError(error);
        return false;
    }
    plan.configFile = db::PathResolver::GetContainerFolder_SettingFilePath(request.folder);
    if (wxFileName::FileExists(plan.configFile))
    {
        PrintError(request.folder + " is a hot folder already (" + plan.configFile + ")");
        return false;
    }
    const wxString modulePath = LocateFilterModule(FromUtf8(request.module));
    plan.filter = MakeDefaultFilterNode(modulePath, error, &plan.info);
    if (!plan.filter)
    {
        PrintError(error);
        return false;
    }
    return true;
}

// The server description, the printer description and the queue the folder
// prints on, beside Folder.cfg.
bool StoreServer(const InitRequest& request, const InitPlan& plan)
{
    if (plan.server.IsEmpty())
        return true;
    if (!StoreServerBeside(request.folder, plan.server, plan.ppdBytes))
        return false;
    if (!request.queue.empty() && !StoreBeside(request.folder, HotFolder::kPrinterQueueName,
                                               request.queue + "\n", "printer queue"))
        return false;
    wxArrayString missing = plan.server.MissingFeatures(plan.info.m_arrRequiredServerFeatures);
    if (!missing.empty())
        PrintError("warning: the server does not offer " + wxJoin(missing, ' ') +
                   ", which the filter needs");
    return true;
}

// Makes the folders and writes the configuration. Returns the exit status.
int ExecuteInit(const InitRequest& request, InitPlan& plan)
{
    const wxString& folder = request.folder;
    wxString error;
    db::FolderConfiguration folders;
    folders.SetHotFolder(folder);
    folders.SetWorkFolder(db::PathResolver::GetWorkFolderPath(folder));
    folders.SetFailFolder(db::PathResolver::GetFailFolderPath(folder));
    folders.SetBackupFolder(db::PathResolver::GetBackUpFolderPath(folder));
    for (const wxString& directory :
         {folders.GetWorkFolder(), folders.GetFailFolder(), folders.GetBackupFolder()})
        if (!MakeDirectories(directory, error))
        {
            PrintError(error);
            return kExitSetupFailed;
        }

    const wxArrayString& dirs = request.folderName.GetDirs();
    db::Setting setting;
    setting.SetName(!request.name.empty() ? FromUtf8(request.name)
                    : dirs.empty()        ? folder
                                          : dirs.Last());
    setting.SetDescription(plan.info.m_strDisplayName + " hot folder");
    setting.SetStatusEnable(true);
    setting.SetInputFormats(
        {db::Setting::PairString(plan.info.m_strIdentifier, plan.info.m_strDisplayName)});

    wxXmlNode filterSetting(wxXML_ELEMENT_NODE, "FilterSetting");
    filterSetting.AddChild(plan.filter.release());
    db::FilterConfiguration filters;
    filters.SetFilterSettingNode(filterSetting);

    if (!StoreServer(request, plan))
        return kExitSetupFailed;

    wxString saved;
    if (db::HFDatabase::WriteFolderProperties(plan.configFile, setting, db::JobConfiguration(),
                                              folders, filters, db::ImposeConfiguration(),
                                              db::PreflightConfiguration(), saved) != 0)
    {
        PrintError("cannot write the folder configuration " + plan.configFile);
        return kExitSetupFailed;
    }
    // The service serves only a container no one but its owner may change.
    KeepToTheOwner(folder);
    // The list's writer makes only the last level of the warehouse.
    wxString ignored;
    MakeDirectories(db::PathResolver::GetWarehousePath(), ignored);
    if (!IsListed(folder) && !db::HFDatabase::AddToHotfolderList(folder))
        PrintError("warning: cannot add " + folder + " to the machine-wide hot-folder list in " +
                   db::PathResolver::GetWarehousePath());
    PrintLine("Hot folder:     " + folder);
    PrintLine("Configuration:  " + plan.configFile);
    PrintLine("Filter:         " + plan.info.m_strIdentifier);
    PrintLine("Server:         " + (plan.server.IsEmpty() ? wxString("(none)") : plan.origin));
    return kExitSuccess;
}
} // namespace

int RunInitCommand(const Arguments& args)
{
    InitRequest request;
    int status = kExitSuccess;
    if (!ParseInitRequest(args, request, status))
        return status;
    InitPlan plan;
    if (!PrepareInit(request, plan))
        return kExitSetupFailed;
    return ExecuteInit(request, plan);
}
