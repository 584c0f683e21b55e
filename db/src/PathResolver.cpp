#include "db/PathResolver.h"

#include <cerrno>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <wx/utils.h>

#include "SharedDirectory.h"
#include "db/ConfigurationReader.h"
#include "db/HFDatabase.h"
#include "db/TempFolderCreator.h"
#include "posix/UniqueFd.h"

namespace db
{
namespace
{
const char* const kContainer = "[_Orv_HotFolder_]";

wxString AsDirectory(const wxFileName& name)
{
    return name.GetPath(wxPATH_GET_VOLUME | wxPATH_GET_SEPARATOR);
}

wxString InContainer(const wxString& hotFolder, const wxString& subDirectory)
{
    wxFileName name = wxFileName::DirName(PathResolver::GetContainerFolderPath(hotFolder));
    name.AppendDir(subDirectory);
    return AsDirectory(name);
}

wxString FileInContainer(const wxString& hotFolder, const wxString& file)
{
    return wxFileName(PathResolver::GetContainerFolderPath(hotFolder), file).GetFullPath();
}

wxString WarehouseSubDirectory(const wxString& subDirectory)
{
    wxFileName name = wxFileName::DirName(PathResolver::GetWarehousePath());
    name.AppendDir(subDirectory);
    return AsDirectory(name);
}
} // namespace

wxString PathResolver::GetWarehousePath()
{
    wxString root;
    if (!wxGetEnv("HOTFOLDER_WAREHOUSE_ROOT", &root) || root.empty())
        root = "/var/lib/";
    wxFileName name = wxFileName::DirName(root);
    name.AppendDir("HotFolders");
    return AsDirectory(name);
}

wxString PathResolver::GetPreferencesPath()
{
    const wxString path = WarehouseSubDirectory("Preference");
    MakeSharedDirectory(path, true);
    return path;
}

wxString PathResolver::GetServerDatabasePath(const stHFServerInfo& server)
{
    return WarehouseSubDirectory(server.m_strServerDirectory);
}

wxString PathResolver::GetSettingsPath(const stHFServerInfo& server, const wxString& name)
{
    return wxFileName(GetServerDatabasePath(server), name + ".cfg").GetFullPath();
}

wxString PathResolver::GetSettingsPath(const stHFServerInfo& server, const Setting& setting)
{
    return GetSettingsPath(server, setting.GetName());
}

wxString PathResolver::GetContainerFolderPath()
{
    return kContainer;
}

wxString PathResolver::GetOldContainerFolderPath()
{
    return "[_Orv_HotFolder_Old]";
}

wxString PathResolver::GetMACOldContainerFolderPath()
{
    return "_Orv_HotFolder_";
}

wxString PathResolver::GetContainerFolderPath(const wxString& hotFolder)
{
    wxFileName name = wxFileName::DirName(hotFolder);
    name.AppendDir(kContainer);
    return AsDirectory(name);
}

wxString PathResolver::GetContainerFolder_SettingFilePath(const wxString& hotFolder)
{
    return FileInContainer(hotFolder, "Folder.cfg");
}

wxString PathResolver::GetServerPPD_FilePath(const wxString& hotFolder)
{
    return FileInContainer(hotFolder, "server.ppd");
}

wxString PathResolver::GetWorkFolderPath(const wxString& hotFolder)
{
    return InContainer(hotFolder, "[WorkFolder]");
}

wxString PathResolver::GetFailFolderPath(const wxString& hotFolder)
{
    return InContainer(hotFolder, "[FailedFolder]");
}

wxString PathResolver::GetBackUpFolderPath(const wxString& hotFolder)
{
    return InContainer(hotFolder, "[MoveFolder]");
}

wxString PathResolver::GetDefaultKeepOriginalPath(const wxString& hotFolder)
{
    return GetBackUpFolderPath(hotFolder);
}

wxString PathResolver::GetDefaultFailFolderPath(const wxString& hotFolder)
{
    return GetFailFolderPath(hotFolder);
}

wxString PathResolver::GetTempLocationForWorkFolder(const wxString& hotFolder)
{
    const wxString file = GetContainerFolder_SettingFilePath(hotFolder);
    FolderConfiguration folders;
    ConfigurationReader::ReadFolderConfiguration(file, folders);
    wxFileName name = wxFileName::DirName(folders.GetWorkFolder());
    name.AppendDir(utils::TempFolderCreator::GetTempFolder());
    return AsDirectory(name);
}

wxFileName PathResolver::GetStopAllHFFilePath()
{
    const wxString warehouse = GetWarehousePath();
    MakeSharedDirectory(warehouse, true);
    return wxFileName(warehouse, "StopHF");
}

wxString PathResolver::GetRunServiceFileName()
{
    const wxString service = WarehouseSubDirectory("Service");
    MakeSharedDirectory(service, true);
    return wxFileName(service, "RunService").GetFullPath();
}

bool PathResolver::CreateRunServiceFile()
{
    const std::string path(GetRunServiceFileName().fn_str());
    const posix::UniqueFd fd(::open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666));
    if (!fd)
        return false;
    ::fchmod(fd.Get(), 0666); // every user's service must be able to remove it
    return true;
}

bool PathResolver::DeleteRunServiceFile()
{
    const std::string path(GetRunServiceFileName().fn_str());
    return ::unlink(path.c_str()) == 0;
}
} // namespace db
