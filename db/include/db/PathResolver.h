#pragma once
#include <wx/filename.h>
#include <wx/string.h>

#include "db/Setting.h"
#include "hotfolder/ServerInfo.h"

namespace db
{
// Where the client keeps its files. The warehouse is "/var/lib/HotFolders/"
// (the environment variable HOTFOLDER_WAREHOUSE_ROOT replaces "/var/lib/");
// every hot folder holds a container "[_Orv_HotFolder_]". Directories are
// returned with a trailing separator. Directories shared by every user are
// created with mode 0777 whatever the umask.
class PathResolver
{
public:
    static wxString GetWarehousePath();
    // Created (with parents) when missing.
    static wxString GetPreferencesPath();
    static wxString GetServerDatabasePath(const stHFServerInfo& server);
    static wxString GetSettingsPath(const stHFServerInfo& server, const wxString& name);
    static wxString GetSettingsPath(const stHFServerInfo& server, const Setting& setting);

    // The bare container names.
    static wxString GetContainerFolderPath();
    static wxString GetOldContainerFolderPath();
    static wxString GetMACOldContainerFolderPath();

    static wxString GetContainerFolderPath(const wxString& hotFolder);
    static wxString GetContainerFolder_SettingFilePath(const wxString& hotFolder);
    static wxString GetServerPPD_FilePath(const wxString& hotFolder);
    static wxString GetWorkFolderPath(const wxString& hotFolder);
    static wxString GetFailFolderPath(const wxString& hotFolder);
    static wxString GetBackUpFolderPath(const wxString& hotFolder);
    static wxString GetDefaultKeepOriginalPath(const wxString& hotFolder);
    static wxString GetDefaultFailFolderPath(const wxString& hotFolder);

    // The work folder recorded in the hot folder's Folder.cfg with a fresh
    // temporary directory name appended (not created).
    static wxString GetTempLocationForWorkFolder(const wxString& hotFolder);

    // "StopHF" in the warehouse (the warehouse is created when missing).
    static wxFileName GetStopAllHFFilePath();
    // "Service/RunService" in the warehouse ("Service" created when missing).
    static wxString GetRunServiceFileName();
    // Creates the empty marker (mode 0666) unless it exists.
    static bool CreateRunServiceFile();
    static bool DeleteRunServiceFile();
};
} // namespace db
