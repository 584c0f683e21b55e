#include "db/HFDatabase.h"

#include <memory>

#include <wx/filename.h>

#include "SharedDirectory.h"
#include "XmlHelper.h"
#include "db/AtomicFile.h"
#include "db/PathResolver.h"
#include "hotfolder/HFTranslations.h"

namespace db
{
namespace
{
wxString PreferencesFile()
{
    return wxFileName(PathResolver::GetWarehousePath(), "Preferences", "cfg").GetFullPath();
}

const char* Flag(bool on)
{
    return on ? "1" : "0";
}

// The stored word is compared with the untranslated keywords, while the
// writer stores the translated word: a language whose word differs reads
// back as inches. Kept so for compatibility with existing files.
wxString UnitFromStoredText(const wxString& stored)
{
    HFTranslations* translations = HFTranslations::GetInstance();
    if (stored.IsSameAs("mm", false))
        return translations->Translate("mm");
    if (stored.IsSameAs("point", false))
        return translations->Translate("point");
    return translations->Translate("inch");
}
} // namespace

int HFDatabase::ReadPreferences(Preference& preference)
{
    const wxString path = PreferencesFile();
    if (!wxFileName::FileExists(path))
        return 0;
    const std::unique_ptr<wxXmlDocument> document(
        CXmlDocumentHelper::Load(ToStdStr(path), L"UTF-8"));
    if (!document || !document->GetRoot())
        return -1;
    WxStrAttributeMap attributes;
    CXmlNodeHelper::Read(document->GetRoot(), attributes);
    auto text = [&attributes](const char* key, wxString& value)
    {
        const auto found = attributes.find(key);
        if (found == attributes.end())
            return false;
        value = found->second;
        return true;
    };

    // A file from an older version with fewer keys loads its leading part:
    // the first missing key ends the reading.
    wxString value;
    do
    {
        if (!text("AppLanguage", value))
            break;
        preference.SetAppLang(value);
        if (!text("Units", value))
            break;
        preference.SetUnit(UnitFromStoredText(value));
        if (!text("UserChangedUnit", value))
            break;
        preference.SetUserUnitChanged(value);
        if (!text("ImposePresetLocation", value))
            break;
        preference.SetImpositionPresetLocation(value);
        if (!text("TimeInterval", value))
            break;
        preference.SetTimeInterval(value);
        if (!text("IsCustomLocation", value))
            break;
        preference.SetStatusCustomLocation(value == "1");
        if (!text("SaveLocation", value))
            break;
        preference.SetJobsSaveLocation(value);
        if (!text("IsClearOriginalJobs", value))
            break;
        preference.SetStatusClearOriginal(value == "1");
        if (!text("ClearOriginalJobsValue", value))
            break;
        preference.SetOroginalJobClearValue(value);
        if (!text("IsClearFailedJobs", value))
            break;
        preference.SetStatusClearFailed(value == "1");
        if (!text("ClearFailedJobsValue", value))
            break;
        preference.SetFailedJobClearValue(value);
        if (!text("IsAutoRefreshPreset", value))
            break;
        preference.SetStatusAutoRefresh(value == "1");
        if (!text("AutoRefreshPresetValue", value))
            break;
        preference.SetAutoRefreshPresetValue(value);
    } while (false);
    return -1;
}

int HFDatabase::WritePreferences(const Preference& preference)
{
    MakeSharedDirectory(PathResolver::GetWarehousePath(), false);
    wxXmlNode* root = new wxXmlNode(wxXML_ELEMENT_NODE, "Preferences");
    root->AddAttribute("AppLanguage", preference.GetAppLang());
    root->AddAttribute("Units", preference.GetUnit());
    root->AddAttribute("UserChangedUnit", preference.GetUserUnitChanged());
    root->AddAttribute("ImposePresetLocation", preference.GetImpositionPresetLocation());
    root->AddAttribute("TimeInterval", preference.GetTimeInterval());
    root->AddAttribute("IsCustomLocation", Flag(preference.GetStatusCustomLocation()));
    root->AddAttribute("SaveLocation", preference.GetJobsSaveLocation());
    root->AddAttribute("IsClearOriginalJobs", Flag(preference.GetStatusClearOriginal()));
    root->AddAttribute("ClearOriginalJobsValue", preference.GetOroginalJobClearValue());
    root->AddAttribute("IsClearFailedJobs", Flag(preference.GetStatusClearFailed()));
    root->AddAttribute("ClearFailedJobsValue", preference.GetFailedJobClearValue());
    root->AddAttribute("IsAutoRefreshPreset", Flag(preference.GetStatusAutoRefresh()));
    root->AddAttribute("AutoRefreshPresetValue", preference.GetAutoRefreshPresetValue());
    wxXmlDocument document;
    document.SetFileEncoding("UTF-8");
    document.SetRoot(root);
    return AtomicFile::WriteXml(PreferencesFile(), document, 2) ? 0 : -1;
}
} // namespace db
