#include "cli/FolderCreation.h"

#include <wx/filename.h>
#include <wx/xml/xml.h>

#include "cli/ConsoleText.h"
#include "cli/QueueBinding.h"
#include "cli/ServerBinding.h"
#include "db/HFDatabase.h"
#include "db/PathResolver.h"
#include "folder/FileMoves.h"
#include "folder/HotFolder.h"
#include "module/FilterSession.h"
#include "service/FolderAccess.h"

FolderCreationPlan::FolderCreationPlan() = default;
FolderCreationPlan::~FolderCreationPlan() = default;

namespace
{
bool IsListed(const wxString& folder)
{
    wxArrayString folders;
    db::HFDatabase::ReadFoldersList(folders);
    for (const wxString& listed : folders)
        if (wxFileName::DirName(listed).SameAs(wxFileName::DirName(folder)))
            return true;
    return false;
}

// The server description, the printer description and the queue the folder
// prints on, beside Folder.cfg.
bool StoreServer(const FolderCreationRequest& request, const FolderCreationPlan& plan,
                 std::vector<wxString>& warnings, wxString& error)
{
    if (plan.server.IsEmpty())
        return true;
    if (!StoreServerBeside(request.folder, plan.server, plan.ppdBytes, error))
        return false;
    if (!request.queue.empty() && !StoreBeside(request.folder, HotFolder::kPrinterQueueName,
                                               request.queue + "\n", "printer queue", error))
        return false;
    wxArrayString missing = plan.server.MissingFeatures(plan.info.m_arrRequiredServerFeatures);
    if (!missing.empty())
        warnings.push_back("the server does not offer " + wxJoin(missing, ' ') +
                           ", which the filter needs");
    return true;
}
} // namespace

bool PlanFolderCreation(const FolderCreationRequest& request, FolderCreationPlan& plan,
                        wxString& error)
{
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
        return false;
    plan.configFile = db::PathResolver::GetContainerFolder_SettingFilePath(request.folder);
    if (wxFileName::FileExists(plan.configFile))
    {
        error = request.folder + " is a hot folder already (" + plan.configFile + ")";
        return false;
    }
    plan.filter = MakeDefaultFilterNode(request.modulePath, error, &plan.info);
    return plan.filter != nullptr;
}

bool CreatePlannedFolder(const FolderCreationRequest& request, FolderCreationPlan& plan,
                         std::vector<wxString>& warnings, wxString& error)
{
    const wxString& folder = request.folder;
    db::FolderConfiguration folders;
    folders.SetHotFolder(folder);
    folders.SetWorkFolder(db::PathResolver::GetWorkFolderPath(folder));
    folders.SetFailFolder(db::PathResolver::GetFailFolderPath(folder));
    folders.SetBackupFolder(db::PathResolver::GetBackUpFolderPath(folder));
    for (const wxString& directory :
         {folders.GetWorkFolder(), folders.GetFailFolder(), folders.GetBackupFolder()})
        if (!MakeDirectories(directory, error))
            return false;

    const wxArrayString dirs = wxFileName::DirName(folder).GetDirs();
    db::Setting setting;
    setting.SetName(!request.name.empty() ? request.name : dirs.empty() ? folder : dirs.Last());
    setting.SetDescription(plan.info.m_strDisplayName + " hot folder");
    setting.SetStatusEnable(true);
    setting.SetInputFormats(
        {db::Setting::PairString(plan.info.m_strIdentifier, plan.info.m_strDisplayName)});

    wxXmlNode filterSetting(wxXML_ELEMENT_NODE, "FilterSetting");
    filterSetting.AddChild(plan.filter.release());
    db::FilterConfiguration filters;
    filters.SetFilterSettingNode(filterSetting);

    if (!StoreServer(request, plan, warnings, error))
        return false;

    wxString saved;
    if (db::HFDatabase::WriteFolderProperties(plan.configFile, setting, db::JobConfiguration(),
                                              folders, filters, db::ImposeConfiguration(),
                                              db::PreflightConfiguration(), saved) != 0)
    {
        error = "cannot write the folder configuration " + plan.configFile;
        return false;
    }
    // The service serves only a container no one but its owner may change.
    KeepToTheOwner(folder);
    // The list's writer makes only the last level of the warehouse.
    wxString ignored;
    MakeDirectories(db::PathResolver::GetWarehousePath(), ignored);
    if (!IsListed(folder) && !db::HFDatabase::AddToHotfolderList(folder))
        warnings.push_back("cannot add " + folder + " to the machine-wide hot-folder list in " +
                           db::PathResolver::GetWarehousePath());
    return true;
}
