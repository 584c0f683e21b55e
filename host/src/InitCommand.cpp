// hotfolder init: makes a folder a hot folder.
#include <memory>

#include <wx/filename.h>
#include <wx/xml/xml.h>

#include "CommandLine.h"
#include "Commands.h"
#include "ConsoleText.h"
#include "FileMoves.h"
#include "FilterSession.h"
#include "HotFolder.h"
#include "ModuleLocator.h"
#include "ServerDescription.h"
#include "db/AtomicFile.h"
#include "db/HFDatabase.h"
#include "db/PathResolver.h"

static const char kInitUsage[] =
    "usage: hotfolder init FOLDER [--server FILE] [--name NAME] [--module PATH]\n"
    "\n"
    "Makes FOLDER (created when missing) a hot folder: its container\n"
    "\"[_Orv_HotFolder_]\" with Folder.cfg (name, work, failed and kept-originals\n"
    "folders, the filter's default settings), a copy of the server description\n"
    "FILE beside it, and an entry in the machine-wide hot-folder list.\n"
    "NAME defaults to the folder's own name.\n";

static bool IsListed(const wxString& folder)
{
    wxArrayString folders;
    db::HFDatabase::ReadFoldersList(folders);
    for (const wxString& listed : folders)
        if (wxFileName::DirName(listed).SameAs(wxFileName::DirName(folder)))
            return true;
    return false;
}

int RunInitCommand(const Arguments& args)
{
    ParsedArgs parsed;
    int status = 0;
    if (!ParseCommandLine(args, {{"--server", true, false, ""}, {"--name", true, false, ""}},
                          kInitUsage, 1, 1, parsed, status))
        return status;

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
        if (!db::AtomicFile::Write(stored, ToUtf8(server.GetText())))
        {
            PrintError("cannot store the server description in " + stored);
            return kExitSetupFailed;
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
    PrintLine("Server:         " +
              (server.IsEmpty() ? wxString("(none)") : FromUtf8(parsed.Get("--server"))));
    return kExitSuccess;
}
