#include "db/HFDatabase.h"

#include <wx/filename.h>

#include "FolderFileBlocks.h"
#include "XmlHelper.h"
#include "db/AtomicFile.h"
#include "db/VelmarDBXMLHelper.h"

namespace db
{
namespace
{
bool SameKey(wxString stored, wxString wanted)
{
    // Keys typed with a different case or trailing blanks name the same
    // setting; the newest spelling replaces the stored one.
    return stored.Trim(true).IsSameAs(wanted.Trim(true), false);
}

// Rewrites path from everything a loaded document holds, with the given
// change applied to the setting or the job overrides first.
template <typename Change> bool RewriteFrom(const wxString& path, wxXmlNode* root, Change change)
{
    Setting setting;
    FolderConfiguration folders;
    FilterConfiguration filter;
    JobConfiguration job;
    ImposeConfiguration impose;
    PreflightConfiguration preflight;
    folderfile::ReadSettings(root, setting);
    folderfile::ReadFolders(root, folders);
    folderfile::ReadFilter(root, filter);
    folderfile::ReadJob(root, job);
    folderfile::ReadImpose(root, impose);
    folderfile::ReadPreflight(root, preflight);
    change(setting, job);
    wxString saved;
    return HFDatabase::WriteFolderProperties(path, setting, job, folders, filter, impose, preflight,
                                             saved) == 0;
}
} // namespace

int HFDatabase::ReadSetting(const wxString& path, Setting& setting)
{
    return VelmarDBXMLHelper::ReadSettingsInfo(path, setting);
}

int HFDatabase::WriteFolderProperties(const wxString& path, const Setting& setting,
                                      const JobConfiguration& jobConfiguration,
                                      const FolderConfiguration& folderConfiguration,
                                      const FilterConfiguration& filterConfiguration,
                                      const ImposeConfiguration& imposeConfiguration,
                                      const PreflightConfiguration& preflightConfiguration,
                                      wxString& savedPath)
{
    wxXmlDocument document;
    document.SetFileEncoding("UTF-8");
    document.SetRoot(folderfile::BuildRoot(setting, jobConfiguration, folderConfiguration,
                                           filterConfiguration, imposeConfiguration,
                                           preflightConfiguration));
    savedPath = path;
    return AtomicFile::WriteXml(path, document, 2) ? 0 : -1;
}

bool HFDatabase::WriteJobOverrides(const wxString& folder, const wxArrayString& keys,
                                   const wxArrayString& values)
{
    const wxString path = wxFileName(folder, "Folder", "cfg").GetFullPath();
    if (!wxFileName::FileExists(path) || keys.empty())
        return false;
    // One snapshot for the whole merge. A file that does not load is left as
    // it is rather than replaced by what little could be salvaged.
    const std::unique_ptr<wxXmlDocument> document = folderfile::LoadWithRoot(path);
    if (!document)
        return false;
    return RewriteFrom(path, document->GetRoot(),
                       [&keys, &values](Setting&, JobConfiguration& job)
                       {
                           JobConfiguration::Map entries;
                           job.GetProperties(entries);
                           for (size_t i = 0; i < keys.size(); ++i)
                           {
                               for (auto it = entries.begin(); it != entries.end();)
                                   it = SameKey(it->first, keys[i]) ? entries.erase(it) : ++it;
                               const wxString value = i < values.size() ? values[i] : wxString();
                               entries.emplace(keys[i],
                                               JobConfiguration::PairString(value, value, value));
                           }
                           job.SetProperties(entries);
                       });
}

int HFDatabase::UpdateFolderStatus(const wxString& path, bool enable)
{
    const std::unique_ptr<wxXmlDocument> document = folderfile::LoadWithRoot(path);
    if (!document)
        return -1;
    // Replace the value in place so every other attribute keeps its position.
    wxXmlNode* root = document->GetRoot();
    wxXmlAttribute* enableAttribute =
        CXmlPropertyHelper::Find(root->GetAttributes(), CStdStr<wchar_t>(L"Enable"));
    if (enableAttribute)
        enableAttribute->SetValue(enable ? "1" : "0");
    else
        root->AddAttribute("Enable", enable ? "1" : "0");
    document->SetFileEncoding("UTF-8");
    return AtomicFile::WriteXml(path, *document, 2) ? 0 : -1;
}

bool HFDatabase::UpdateServerName(const wxString& path, const wxString& serverName)
{
    if (!wxFileName::FileExists(path))
        return false;
    const std::unique_ptr<wxXmlDocument> document = folderfile::LoadWithRoot(path);
    if (!document)
        return false;
    Setting current;
    folderfile::ReadSettings(document->GetRoot(), current);
    if (current.GetServerName() == serverName)
        return false;
    return RewriteFrom(path, document->GetRoot(),
                       [&serverName](Setting& setting, JobConfiguration&)
                       { setting.SetServerName(serverName); });
}
} // namespace db
