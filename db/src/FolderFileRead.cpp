#include "FolderFileBlocks.h"

#include <cwchar>

#include "AttributeChain.h"
#include "XmlHelper.h"

namespace db
{
namespace folderfile
{
namespace
{
long long ParseLong(const wxString& text)
{
    return std::wcstoll(text.wc_str(), nullptr, 10);
}

// Numbers stored by "%d": on when not zero.
template <auto Set>
void AsNonZero(typename SetterClass<decltype(Set)>::Type& target, const wxString& text)
{
    (target.*Set)(ParseLong(text) != 0);
}

// The root attributes in reading order (not the writing order). The first
// four are mandatory; from "Enable" on, a missing key ends the reading, except
// "server_version", which older writers did not always store.
const AttributeLink<Setting> kSettingAttributes[] = {
    {"name", &AsText<&Setting::SetName>},
    {"description", &AsText<&Setting::SetDescription>},
    {"server_ip", &AsText<&Setting::SetServerIP>},
    {"server_name", &AsText<&Setting::SetServerName>},
    {"Enable", &AsOneFlag<&Setting::SetStatusEnable>},
    {"BaseVirtualPrinter", &AsText<&Setting::SetBaseVirtualPrinter>},
    {"BaseVirtualPrinterName", &AsText<&Setting::SetBaseVirtualPrinterName>},
    {"BaseVirtualPrinterDisplayName", &AsText<&Setting::SetBaseVirtualPrinterDisplayName>},
    {"HFPresetName", &AsText<&Setting::SetSelectedPreset>},
    {"Centralized", &AsOneFlag<&Setting::SetStatusCentralized>},
    {"Isjobpresetattached", &AsOneFlag<&Setting::SetJobPresetAttched>},
    {"IsCustomInterval", &AsOneFlag<&Setting::SetCustomInterval>},
    {"TimeInterval", &AsText<&Setting::SetCustomTimeInterval>},
    {"PPDVersion", &AsText<&Setting::SetPPDVersion>},
    {"ServerTypeAndJPDefaultKeyInfo", &AsText<&Setting::SetServerTypeAndJPDefaultKeyInfo>},
    {"server_version",
     [](Setting& setting, const wxString& text) { setting.SetServerVersion(ParseLong(text)); },
     true},
    {"server_textversion", &AsText<&Setting::SetTextServerVersion>},
    {"server_type", &AsText<&Setting::SetServerType>},
    {"Quickset", &AsText<&Setting::SetSelectedQuickSet>},
    {"Quickset_Supported", &AsNonZero<&Setting::SetQuickSetsSupported>},
    {"Quickset_Enabled", &AsNonZero<&Setting::EnableQuickSets>},
    {"IsWidthBased", &AsNonZero<&Setting::SetIsWidthBased>},
    {"JobExpert_Supported", &AsNonZero<&Setting::SetJobExpertSupported>},
    {"JobExpert", &AsNonZero<&Setting::EnableJobExpert>},
    {"JobExpertRule",
     [](Setting& setting, const wxString& text) {
         setting.SetJobExpertRule({text, setting.GetJobExpertRule().second});
     }},
    {"JobExpertRuleDisplayValue",
     [](Setting& setting, const wxString& text) {
         setting.SetJobExpertRule({setting.GetJobExpertRule().first, text});
     }},
};
const size_t kMandatorySettingAttributes = 4;

wxString ValueAt(wxXmlAttribute* attributes, size_t index)
{
    return CXmlPropertyHelper::ValueAt(attributes, index);
}

// Hands the attribute list of every child of the named block that has at
// least two attributes to take, in document order: the entries of a block
// are read by attribute position, not by name. False when there is no block.
template <typename Take> bool ReadEntries(wxXmlNode* root, const char* blockName, Take take)
{
    wxXmlNode* block = CXmlNodeHelper::Find(root, blockName, true);
    if (!block)
        return false;
    for (wxXmlNode* child = block->GetChildren(); child; child = child->GetNext())
        if (CXmlPropertyHelper::Count(child->GetAttributes()) >= 2)
            take(child->GetAttributes());
    return true;
}

// A block of setting name to texts: the key is the first attribute, the
// texts are the attributes at the given positions ("" where a child has
// fewer). The first entry of a key wins; the block replaces the whole map.
template <typename Configuration, typename... Position>
void ReadKeyed(wxXmlNode* root, const char* blockName, Configuration& configuration,
               Position... positions)
{
    typename Configuration::Map entries;
    if (ReadEntries(root, blockName,
                    [&entries, positions...](wxXmlAttribute* attributes)
                    {
                        entries.emplace(
                            ValueAt(attributes, 0),
                            typename Configuration::PairString(ValueAt(attributes, positions)...));
                    }))
        configuration.SetProperties(entries);
}
} // namespace

std::unique_ptr<wxXmlDocument> LoadWithRoot(const wxString& path)
{
    std::unique_ptr<wxXmlDocument> document(CXmlDocumentHelper::Load(ToStdStr(path), L"UTF-8"));
    if (!document || !document->GetRoot())
        return nullptr;
    return document;
}

int ReadSettings(wxXmlNode* root, Setting& setting)
{
    if (!root->GetAttributes())
        return -1;
    const int result =
        ReadAttributeChain(root, kSettingAttributes, setting) >= kMandatorySettingAttributes ? 1
                                                                                             : -1;

    if (wxXmlNode* summary = CXmlNodeHelper::Find(root, "InputFormatsSummary", true))
    {
        for (wxXmlNode* format = CXmlNodeHelper::Find(summary, "InputFormat"); format;
             format = CXmlNodeHelper::FindNext(format, "InputFormat"))
        {
            wxString shortName, displayName;
            if (format->GetAttribute("ShortName", &shortName) &&
                format->GetAttribute("DisplayName", &displayName))
                setting.GetInputFormats().emplace_back(shortName, displayName);
        }
    }
    return result;
}

void ReadFolders(wxXmlNode* root, FolderConfiguration& configuration)
{
    wxXmlNode* paths = CXmlNodeHelper::Find(root, "Paths", true);
    if (!paths)
        return;
    auto read = [paths](const char* name, void (FolderConfiguration::*set)(const wxString&),
                        FolderConfiguration& target)
    {
        const wxXmlNode* node = CXmlNodeHelper::Find(paths, name);
        if (node && node->GetAttributes())
            (target.*set)(node->GetAttributes()->GetValue());
    };
    read("Workfolder", &FolderConfiguration::SetWorkFolder, configuration);
    read("Failfolder", &FolderConfiguration::SetFailFolder, configuration);
    read("Movefolder", &FolderConfiguration::SetBackupFolder, configuration);
    read("Hotfolder", &FolderConfiguration::SetHotFolder, configuration);
}

void ReadFilter(wxXmlNode* root, FilterConfiguration& configuration)
{
    if (const wxXmlNode* node = CXmlNodeHelper::Find(root, "FilterSetting", true))
        configuration.SetFilterSettingNode(*node);
}

void ReadJob(wxXmlNode* root, JobConfiguration& configuration)
{
    // Key, value, display value, localised display value.
    ReadKeyed(root, "JobSetting", configuration, 1, 2, 3);
}

void ReadImpose(wxXmlNode* root, ImposeConfiguration& configuration)
{
    // Key, value, display value.
    ReadKeyed(root, "ImposeSetting", configuration, 1, 2);
}

void ReadPreflight(wxXmlNode* root, PreflightConfiguration& configuration)
{
    PreflightConfiguration::List entries;
    if (ReadEntries(root, "PreflightSettings",
                    [&entries](wxXmlAttribute* attributes)
                    { entries.emplace_back(ValueAt(attributes, 0), ValueAt(attributes, 1)); }))
        configuration.SetProperties(entries);
}
} // namespace folderfile
} // namespace db
