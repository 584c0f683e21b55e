#include "FolderFileBlocks.h"

#include <cwchar>

#include "XmlHelper.h"

namespace db
{
namespace folderfile
{
namespace
{
// Attribute values by position: the readers do not look at attribute names.
wxString AttributeValueAt(const wxXmlNode* node, size_t index)
{
    const wxXmlAttribute* attribute = node->GetAttributes();
    for (size_t i = 0; attribute && i < index; ++i)
        attribute = attribute->GetNext();
    return attribute ? attribute->GetValue() : wxString();
}

size_t AttributeCount(const wxXmlNode* node)
{
    return CXmlPropertyHelper::Count(node->GetAttributes());
}

long long ParseLong(const wxString& text)
{
    return std::wcstoll(text.wc_str(), nullptr, 10);
}

bool IsOne(const wxString& text)
{
    return text == "1";
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
    WxStrAttributeMap attributes;
    CXmlNodeHelper::Read(root, attributes);
    auto text = [&attributes](const char* key, wxString& value)
    {
        const auto found = attributes.find(key);
        if (found == attributes.end())
            return false;
        value = found->second;
        return true;
    };

    int result = -1;
    wxString value;
    do
    {
        if (!text("name", value))
            break;
        setting.SetName(value);
        if (!text("description", value))
            break;
        setting.SetDescription(value);
        if (!text("server_ip", value))
            break;
        setting.SetServerIP(value);
        if (!text("server_name", value))
            break;
        setting.SetServerName(value);
        result = 1;

        // A chain: an older file lacks the later keys, and the first missing
        // one ends the reading ("server_version" alone may be absent).
        if (!text("Enable", value))
            break;
        setting.SetStatusEnable(IsOne(value));
        if (!text("BaseVirtualPrinter", value))
            break;
        setting.SetBaseVirtualPrinter(value);
        if (!text("BaseVirtualPrinterName", value))
            break;
        setting.SetBaseVirtualPrinterName(value);
        if (!text("BaseVirtualPrinterDisplayName", value))
            break;
        setting.SetBaseVirtualPrinterDisplayName(value);
        if (!text("HFPresetName", value))
            break;
        setting.SetSelectedPreset(value);
        if (!text("Centralized", value))
            break;
        setting.SetStatusCentralized(IsOne(value));
        if (!text("Isjobpresetattached", value))
            break;
        setting.SetJobPresetAttched(IsOne(value));
        if (!text("IsCustomInterval", value))
            break;
        setting.SetCustomInterval(IsOne(value));
        if (!text("TimeInterval", value))
            break;
        setting.SetCustomTimeInterval(value);
        if (!text("PPDVersion", value))
            break;
        setting.SetPPDVersion(value);
        if (!text("ServerTypeAndJPDefaultKeyInfo", value))
            break;
        setting.SetServerTypeAndJPDefaultKeyInfo(value);
        if (text("server_version", value))
            setting.SetServerVersion(ParseLong(value));
        if (!text("server_textversion", value))
            break;
        setting.SetTextServerVersion(value);
        if (!text("server_type", value))
            break;
        setting.SetServerType(value);
        if (!text("Quickset", value))
            break;
        setting.SetSelectedQuickSet(value);
        if (!text("Quickset_Supported", value))
            break;
        setting.SetQuickSetsSupported(ParseLong(value) != 0);
        if (!text("Quickset_Enabled", value))
            break;
        setting.EnableQuickSets(ParseLong(value) != 0);
        if (!text("IsWidthBased", value))
            break;
        setting.SetIsWidthBased(ParseLong(value) != 0);
        if (!text("JobExpert_Supported", value))
            break;
        setting.SetJobExpertSupported(ParseLong(value) != 0);
        if (!text("JobExpert", value))
            break;
        setting.EnableJobExpert(ParseLong(value) != 0);
        std::pair<wxString, wxString> rule = setting.GetJobExpertRule();
        if (!text("JobExpertRule", rule.first))
            break;
        setting.SetJobExpertRule(rule);
        if (!text("JobExpertRuleDisplayValue", rule.second))
            break;
        setting.SetJobExpertRule(rule);
    } while (false);

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
    wxXmlNode* block = CXmlNodeHelper::Find(root, "JobSetting", true);
    if (!block)
        return;
    JobConfiguration::Map entries;
    for (const wxXmlNode* child = block->GetChildren(); child; child = child->GetNext())
    {
        if (AttributeCount(child) < 2)
            continue;
        entries.emplace(AttributeValueAt(child, 0),
                        JobConfiguration::PairString(AttributeValueAt(child, 1),
                                                     AttributeValueAt(child, 2),
                                                     AttributeValueAt(child, 3)));
    }
    configuration.SetProperties(entries);
}

void ReadImpose(wxXmlNode* root, ImposeConfiguration& configuration)
{
    wxXmlNode* block = CXmlNodeHelper::Find(root, "ImposeSetting", true);
    if (!block)
        return;
    ImposeConfiguration::Map entries;
    for (const wxXmlNode* child = block->GetChildren(); child; child = child->GetNext())
    {
        if (AttributeCount(child) < 2)
            continue;
        entries.emplace(AttributeValueAt(child, 0),
                        ImposeConfiguration::PairString(AttributeValueAt(child, 1),
                                                        AttributeValueAt(child, 2)));
    }
    configuration.SetProperties(entries);
}

void ReadPreflight(wxXmlNode* root, PreflightConfiguration& configuration)
{
    wxXmlNode* block = CXmlNodeHelper::Find(root, "PreflightSettings", true);
    if (!block)
        return;
    PreflightConfiguration::List entries;
    for (const wxXmlNode* child = block->GetChildren(); child; child = child->GetNext())
        if (AttributeCount(child) >= 2)
            entries.emplace_back(AttributeValueAt(child, 0), AttributeValueAt(child, 1));
    configuration.SetProperties(entries);
}
} // namespace folderfile
} // namespace db
