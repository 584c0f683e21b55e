#include "FolderFileBlocks.h"

namespace db
{
namespace folderfile
{
namespace
{
const char* Flag(bool on)
{
    return on ? "1" : "0";
}

// Children are appended after the last one; wxXmlNode::AddChild would walk
// the whole list for every entry of a long block.
class ChildAppender
{
public:
    explicit ChildAppender(wxXmlNode* parent) : m_pParent(parent) {}
    wxXmlNode* Append(const wxString& name)
    {
        return Adopt(new wxXmlNode(wxXML_ELEMENT_NODE, name));
    }
    wxXmlNode* Adopt(wxXmlNode* child)
    {
        if (m_pLast)
            m_pParent->InsertChildAfter(child, m_pLast);
        else
            m_pParent->AddChild(child);
        m_pLast = child;
        return child;
    }

private:
    wxXmlNode* m_pParent;
    wxXmlNode* m_pLast = nullptr;
};

void AddRootAttributes(wxXmlNode* root, const Setting& setting)
{
    root->AddAttribute("name", setting.GetName());
    root->AddAttribute("description", setting.GetDescription());
    root->AddAttribute("server_ip", setting.GetServerIP());
    root->AddAttribute("server_name", setting.GetServerName());
    root->AddAttribute("server_version", wxString::Format("%lld", static_cast<long long>(
                                                                      setting.GetServerVersion())));
    root->AddAttribute("server_textversion", setting.GetTextServerVersion());
    root->AddAttribute("server_type", setting.GetServerType());
    root->AddAttribute("BaseVirtualPrinter", setting.GetBaseVirtualPrinter());
    root->AddAttribute("BaseVirtualPrinterName", setting.GetBaseVirtualPrinterName());
    root->AddAttribute("BaseVirtualPrinterDisplayName", setting.GetBaseVirtualPrinterDisplayName());
    root->AddAttribute("HFPresetName", setting.GetSelectedPreset());
    root->AddAttribute("PPDVersion", setting.GetPPDVersion());
    root->AddAttribute("ServerTypeAndJPDefaultKeyInfo", setting.GetServerTypeAndJPDefaultKeyInfo());
    // These switches are written as numbers, the ones further down as texts;
    // both forms are part of the file format.
    root->AddAttribute("Quickset_Supported",
                       wxString::Format("%d", static_cast<int>(setting.IsQuickSetsSupported())));
    root->AddAttribute("Quickset_Enabled",
                       wxString::Format("%d", static_cast<int>(setting.IsQuickSetsEnabled())));
    root->AddAttribute("Quickset", setting.GetSelectedQuickSet());
    root->AddAttribute("IsWidthBased",
                       wxString::Format("%d", static_cast<int>(setting.GetIsWidthBased())));
    root->AddAttribute("JobExpert_Supported",
                       wxString::Format("%d", static_cast<int>(setting.IsJobExpertSupported())));
    if (setting.IsJobExpertSupported())
    {
        root->AddAttribute("JobExpert",
                           wxString::Format("%d", static_cast<int>(setting.IsJobExpertEnabled())));
        root->AddAttribute("JobExpertRule", setting.GetJobExpertRule().first);
        root->AddAttribute("JobExpertRuleDisplayValue", setting.GetJobExpertRule().second);
    }
    root->AddAttribute("Enable", Flag(setting.GetStatusEnable()));
    root->AddAttribute("Centralized", Flag(setting.GetStatusCentralized()));
    root->AddAttribute("Isjobpresetattached", Flag(setting.GetJobPresetAttched()));
    root->AddAttribute("IsCustomInterval", Flag(setting.GetCustomInterval()));
    root->AddAttribute("TimeInterval", setting.GetCustomTimeInterval());
}

void AddInputFormats(ChildAppender& blocks, const Setting& setting)
{
    ChildAppender formats(blocks.Append("InputFormatsSummary"));
    for (const Setting::PairString& format : setting.GetInputFormats())
    {
        wxXmlNode* node = formats.Append("InputFormat");
        node->AddAttribute("ShortName", format.GetShortName());
        node->AddAttribute("DisplayName", format.GetDisplayName());
    }
}

void AddPaths(ChildAppender& blocks, const FolderConfiguration& folders)
{
    ChildAppender paths(blocks.Append("Paths"));
    paths.Append("Failfolder")->AddAttribute("path", folders.GetFailFolder());
    paths.Append("Workfolder")->AddAttribute("path", folders.GetWorkFolder());
    paths.Append("Movefolder")->AddAttribute("path", folders.GetBackupFolder());
    paths.Append("Hotfolder")->AddAttribute("path", folders.GetHotFolder());
}

void AddJobSettings(ChildAppender& blocks, const JobConfiguration& job)
{
    ChildAppender entries(blocks.Append("JobSetting"));
    for (const auto& entry : job.GetProperties())
    {
        wxXmlNode* node = entries.Append("KEYVALUE");
        node->AddAttribute("Key", entry.first);
        node->AddAttribute("Value", entry.second.GetValue());
        node->AddAttribute("KeyDisplayValue", entry.second.GetDisplayValue());
        node->AddAttribute("LocDisplayValue", entry.second.GetLocDisplayValue());
    }
}

void AddImposeSettings(ChildAppender& blocks, const ImposeConfiguration& impose)
{
    ChildAppender entries(blocks.Append("ImposeSetting"));
    for (const auto& entry : impose.GetProperties())
    {
        wxXmlNode* node = entries.Append("KEYVALUE");
        node->AddAttribute("Key", entry.first);
        node->AddAttribute("Value", entry.second.GetValue());
        node->AddAttribute("KeyDisplayValue", entry.second.GetDisplayValue());
    }
}

void AddPreflightSettings(ChildAppender& blocks, const PreflightConfiguration& preflight)
{
    ChildAppender entries(blocks.Append("PreflightSettings"));
    for (const PreflightConfiguration::PairString& entry : preflight.GetProperties())
    {
        wxXmlNode* node = entries.Append("Preflight");
        node->AddAttribute("Key", entry.GetKey());
        node->AddAttribute("Value", entry.GetValue());
    }
}
} // namespace

wxXmlNode* BuildRoot(const Setting& setting, const JobConfiguration& jobConfiguration,
                     const FolderConfiguration& folderConfiguration,
                     const FilterConfiguration& filterConfiguration,
                     const ImposeConfiguration& imposeConfiguration,
                     const PreflightConfiguration& preflightConfiguration)
{
    wxXmlNode* root = new wxXmlNode(wxXML_ELEMENT_NODE, "HotFolder");
    AddRootAttributes(root, setting);
    ChildAppender blocks(root);
    AddInputFormats(blocks, setting);
    AddPaths(blocks, folderConfiguration);
    AddJobSettings(blocks, jobConfiguration);
    AddImposeSettings(blocks, imposeConfiguration);
    const wxXmlNode& filter = filterConfiguration.GetFilterSettingNode();
    if (filter.GetType() == wxXML_ELEMENT_NODE && filter.GetName() == "FilterSetting")
        blocks.Adopt(new wxXmlNode(filter));
    AddPreflightSettings(blocks, preflightConfiguration);
    return root;
}
} // namespace folderfile
} // namespace db
