// hotfolder init: makes a folder a hot folder.
#include <cstdio>
#include <fstream>
#include <memory>
#include <sstream>
#include <string>

#include <wx/filename.h>
#include <wx/xml/xml.h>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "folder/FileMoves.h"
#include "module/FilterSession.h"
#include "folder/HotFolder.h"
#include "module/ModuleLocator.h"
#include "folder/ServerDescription.h"
#include "db/AtomicFile.h"
#include "db/HFDatabase.h"
#include "db/PathResolver.h"
#ifdef HF_WITH_PRINTING
#include "ServerFromPpd.h"
#endif

static const char kInitUsage[] =
    "usage: hotfolder init FOLDER [--server FILE | --ppd FILE.ppd] [--name NAME]\n"
    "                             [--module PATH]\n"
    "\n"
    "Makes FOLDER (created when missing) a hot folder: its container\n"
    "\"[_Orv_HotFolder_]\" with Folder.cfg (name, work, failed and kept-originals\n"
    "folders, the filter's default settings), a copy of the server description\n"
    "FILE beside it, and an entry in the machine-wide hot-folder list.\n"
    "NAME defaults to the folder's own name.\n"
    "\n"
    "--ppd FILE.ppd makes the server description from a printer's PPD file\n"
    "(its papers, default paper and custom size limits) and keeps a copy of\n"
    "the PPD as server.ppd beside it.\n";

static bool IsListed(const wxString& folder)
{
    wxArrayString folders;
    db::HFDatabase::ReadFoldersList(folders);
    for (const wxString& listed : folders)
        if (wxFileName::DirName(listed).SameAs(wxFileName::DirName(folder)))
            return true;
    return false;
}

// The description of the printer a PPD file describes, and the file's bytes.
static bool LoadPpdServer(const std::string& ppd, ServerDescription& server, std::string& bytes,
                          wxString& error)
{
#ifdef HF_WITH_PRINTING
    wxString xml;
    std::string reason;
    if (!ServerDescriptionFromPpd(ppd, xml, reason))
    {
        error = FromUtf8(reason);
        return false;
    }
    std::ifstream in(ppd, std::ios::binary);
    std::ostringstream content;
    if (!in || !(content << in.rdbuf()))
    {
        error = "cannot read " + FromUtf8(ppd);
        return false;
    }
    bytes = content.str();
    return server.LoadText(xml, FromUtf8(ppd), error);
#else
    (void)ppd;
    (void)server;
    (void)bytes;
    error = "--ppd is not available in this build (it needs CUPS)";
    return false;
#endif
}

int RunInitCommand(const Arguments& args)
{
    ParsedArgs parsed;
    int status = 0;
    if (!ParseCommandLine(args,
                          {{"--server", true, false, ""},
                           {"--ppd", true, false, ""},
                           {"--name", true, false, ""}},
                          kInitUsage, 1, 1, parsed, status))
        return status;
    if (parsed.Has("--server") && parsed.Has("--ppd"))
    {
        PrintError("--server and --ppd cannot be given together");
        std::fputs(kInitUsage, stderr);
        return kExitUsage;
    }

    wxFileName folderName = wxFileName::DirName(FromUtf8(parsed.positionals[0]));
    folderName.MakeAbsolute();
    const wxString folder = folderName.GetPath();
    wxString error;

    ServerDescription server;
    if (parsed.Has("--server") && !server.Load(FromUtf8(parsed.Get("--server")), error))
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    std::string ppdBytes;
    if (parsed.Has("--ppd") && !LoadPpdServer(parsed.Get("--ppd"), server, ppdBytes, error))
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    const wxString configFile = db::PathResolver::GetContainerFolder_SettingFilePath(folder);
    if (wxFileName::FileExists(configFile))
    {
        PrintError(folder + " is a hot folder already (" + configFile + ")");
        return kExitSetupFailed;
    }
    const wxString modulePath = LocateFilterModule(FromUtf8(parsed.Get("--module")));
    PluginInfo info;
    std::unique_ptr<wxXmlNode> filter(MakeDefaultFilterNode(modulePath, error, &info));
    if (!filter)
    {
        PrintError(error);
        return kExitSetupFailed;
    }

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

    db::Setting setting;
    setting.SetName(parsed.Has("--name")           ? FromUtf8(parsed.Get("--name"))
                    : folderName.GetDirs().empty() ? folder
                                                   : folderName.GetDirs().Last());
    setting.SetDescription(info.m_strDisplayName + " hot folder");
    setting.SetStatusEnable(true);
    setting.SetInputFormats({db::Setting::PairString(info.m_strIdentifier, info.m_strDisplayName)});

    wxXmlNode filterSetting(wxXML_ELEMENT_NODE, "FilterSetting");
    filterSetting.AddChild(filter.release());
    db::FilterConfiguration filters;
    filters.SetFilterSettingNode(filterSetting);

    if (!server.IsEmpty())
    {
        wxString stored = wxFileName(db::PathResolver::GetContainerFolderPath(folder),
                                     HotFolder::kServerDescriptionName)
                              .GetFullPath();
        wxString reason;
        if (!db::AtomicFile::Write(stored, ToUtf8(server.GetText()), &reason))
        {
            PrintError("cannot store the server description in " + stored + ": " + reason);
            return kExitSetupFailed;
        }
        if (parsed.Has("--ppd"))
        {
            const wxString ppdCopy = wxFileName(db::PathResolver::GetContainerFolderPath(folder),
                                                HotFolder::kServerPpdName)
                                         .GetFullPath();
            if (!db::AtomicFile::Write(ppdCopy, ppdBytes, &reason))
            {
                PrintError("cannot store the printer description in " + ppdCopy + ": " + reason);
                return kExitSetupFailed;
            }
        }
        wxArrayString missing = server.MissingFeatures(info.m_arrRequiredServerFeatures);
        if (!missing.empty())
            PrintError("warning: the server does not offer " + wxJoin(missing, ' ') +
                       ", which the filter needs");
    }

    wxString saved;
    if (db::HFDatabase::WriteFolderProperties(configFile, setting, db::JobConfiguration(), folders,
                                              filters, db::ImposeConfiguration(),
                                              db::PreflightConfiguration(), saved) != 0)
    {
        PrintError("cannot write the folder configuration " + configFile);
        return kExitSetupFailed;
    }
    // The list's writer makes only the last level of the warehouse.
    wxString ignored;
    MakeDirectories(db::PathResolver::GetWarehousePath(), ignored);
    if (!IsListed(folder) && !db::HFDatabase::AddToHotfolderList(folder))
        PrintError("warning: cannot add " + folder + " to the machine-wide hot-folder list in " +
                   db::PathResolver::GetWarehousePath());
    PrintLine("Hot folder:     " + folder);
    PrintLine("Configuration:  " + configFile);
    PrintLine("Filter:         " + info.m_strIdentifier);
    const std::string origin = parsed.Has("--ppd") ? parsed.Get("--ppd") : parsed.Get("--server");
    PrintLine("Server:         " + (server.IsEmpty() ? wxString("(none)") : FromUtf8(origin)));
    return kExitSuccess;
}
