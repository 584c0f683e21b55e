#include "db/HFDatabase.h"

#include <memory>

#include <wx/filename.h>

#include "AttributeChain.h"
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

// The attributes in reading order. A file from an older version with fewer
// keys loads its leading part: the first missing key ends the reading.
const AttributeLink<Preference> kPreferenceAttributes[] = {
    {"AppLanguage", &AsText<&Preference::SetAppLang>},
    {"Units", [](Preference& preference, const wxString& text)
     { preference.SetUnit(UnitFromStoredText(text)); }},
    {"UserChangedUnit", &AsText<&Preference::SetUserUnitChanged>},
    {"ImposePresetLocation", &AsText<&Preference::SetImpositionPresetLocation>},
    {"TimeInterval", &AsText<&Preference::SetTimeInterval>},
    {"IsCustomLocation", &AsOneFlag<&Preference::SetStatusCustomLocation>},
    {"SaveLocation", &AsText<&Preference::SetJobsSaveLocation>},
    {"IsClearOriginalJobs", &AsOneFlag<&Preference::SetStatusClearOriginal>},
    {"ClearOriginalJobsValue", &AsText<&Preference::SetOroginalJobClearValue>},
    {"IsClearFailedJobs", &AsOneFlag<&Preference::SetStatusClearFailed>},
    {"ClearFailedJobsValue", &AsText<&Preference::SetFailedJobClearValue>},
    {"IsAutoRefreshPreset", &AsOneFlag<&Preference::SetStatusAutoRefresh>},
    {"AutoRefreshPresetValue", &AsText<&Preference::SetAutoRefreshPresetValue>},
};
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
    ReadAttributeChain(document->GetRoot(), kPreferenceAttributes, preference);
    // -1 whenever the file exists, however much of it was read: callers
    // tell only "found" from "not found".
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
