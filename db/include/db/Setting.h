#pragma once
#include <cstdint>
#include <utility>
#include <vector>

#include <wx/string.h>

namespace db
{
// One hot folder's identity, server binding, switches and input formats: the
// root attributes of its Folder.cfg.
class Setting
{
public:
    // One input format: display name, then short name.
    class PairString
    {
    public:
        PairString() = default;
        PairString(const wxString& shortName, const wxString& displayName)
            : m_strDisplayName(displayName), m_strShortName(shortName)
        {
        }
        const wxString& GetDisplayName() const { return m_strDisplayName; }
        const wxString& GetShortName() const { return m_strShortName; }
        void SetDisplayName(const wxString& name) { m_strDisplayName = name; }
        void SetShortName(const wxString& name) { m_strShortName = name; }
        bool operator==(const PairString& other) const
        {
            return m_strDisplayName == other.m_strDisplayName &&
                   m_strShortName == other.m_strShortName;
        }

    private:
        wxString m_strDisplayName;
        wxString m_strShortName;
    };
    using InputFormats = std::vector<PairString>;

    const wxString& GetName() const { return m_strName; }
    void SetName(const wxString& value) { m_strName = value; }
    const wxString& GetDescription() const { return m_strDescription; }
    void SetDescription(const wxString& value) { m_strDescription = value; }
    const wxString& GetServerIP() const { return m_strServerIP; }
    void SetServerIP(const wxString& value) { m_strServerIP = value; }
    const wxString& GetServerName() const { return m_strServerName; }
    void SetServerName(const wxString& value) { m_strServerName = value; }
    int64_t GetServerVersion() const { return m_llServerVersion; }
    void SetServerVersion(int64_t value) { m_llServerVersion = value; }
    const wxString& GetBaseVirtualPrinter() const { return m_strBaseVirtualPrinter; }
    void SetBaseVirtualPrinter(const wxString& value) { m_strBaseVirtualPrinter = value; }
    const wxString& GetBaseVirtualPrinterName() const { return m_strBaseVirtualPrinterName; }
    void SetBaseVirtualPrinterName(const wxString& value) { m_strBaseVirtualPrinterName = value; }
    const wxString& GetBaseVirtualPrinterDisplayName() const
    {
        return m_strBaseVirtualPrinterDisplayName;
    }
    void SetBaseVirtualPrinterDisplayName(const wxString& value)
    {
        m_strBaseVirtualPrinterDisplayName = value;
    }
    bool GetStatusEnable() const { return m_bEnable; }
    void SetStatusEnable(bool value) { m_bEnable = value; }
    const InputFormats& GetInputFormats() const { return m_vInputFormats; }
    InputFormats& GetInputFormats() { return m_vInputFormats; }
    void SetInputFormats(const InputFormats& value) { m_vInputFormats = value; }
    bool GetStatusCentralized() const { return m_bCentralized; }
    void SetStatusCentralized(bool value) { m_bCentralized = value; }
    bool GetJobPresetAttched() const { return m_bJobPresetAttached; }
    void SetJobPresetAttched(bool value) { m_bJobPresetAttached = value; }
    bool GetCustomInterval() const { return m_bCustomInterval; }
    void SetCustomInterval(bool value) { m_bCustomInterval = value; }
    const wxString& GetCustomTimeInterval() const { return m_strCustomTimeInterval; }
    void SetCustomTimeInterval(const wxString& value) { m_strCustomTimeInterval = value; }
    const wxString& GetSettingPath() const { return m_strSettingPath; }
    void SetSettingPath(const wxString& value) { m_strSettingPath = value; }
    const wxString& GetSelectedPreset() const { return m_strSelectedPreset; }
    void SetSelectedPreset(const wxString& value) { m_strSelectedPreset = value; }
    const wxString& GetPPDVersion() const { return m_strPPDVersion; }
    void SetPPDVersion(const wxString& value) { m_strPPDVersion = value; }
    const wxString& GetServerTypeAndJPDefaultKeyInfo() const
    {
        return m_strServerTypeAndJPDefaultKeyInfo;
    }
    void SetServerTypeAndJPDefaultKeyInfo(const wxString& value)
    {
        m_strServerTypeAndJPDefaultKeyInfo = value;
    }
    const wxString& GetTextServerVersion() const { return m_strTextServerVersion; }
    void SetTextServerVersion(const wxString& value) { m_strTextServerVersion = value; }
    const wxString& GetServerType() const { return m_strServerType; }
    void SetServerType(const wxString& value) { m_strServerType = value; }
    bool IsQuickSetsSupported() const { return m_bQuickSetsSupported; }
    void SetQuickSetsSupported(bool value) { m_bQuickSetsSupported = value; }
    bool IsQuickSetsEnabled() const { return m_bQuickSetsEnabled; }
    void EnableQuickSets(bool value) { m_bQuickSetsEnabled = value; }
    const wxString& GetSelectedQuickSet() const { return m_strSelectedQuickSet; }
    void SetSelectedQuickSet(const wxString& value) { m_strSelectedQuickSet = value; }
    bool GetIsWidthBased() const { return m_bWidthBased; }
    void SetIsWidthBased(bool value) { m_bWidthBased = value; }
    bool IsJobExpertSupported() const { return m_bJobExpertSupported; }
    void SetJobExpertSupported(bool value) { m_bJobExpertSupported = value; }
    bool IsJobExpertEnabled() const { return m_bJobExpertEnabled; }
    void EnableJobExpert(bool value) { m_bJobExpertEnabled = value; }
    // (rule, display value)
    const std::pair<wxString, wxString>& GetJobExpertRule() const { return m_JobExpertRule; }
    void SetJobExpertRule(const std::pair<wxString, wxString>& value) { m_JobExpertRule = value; }

private:
    wxString m_strName;
    wxString m_strDescription;
    wxString m_strServerIP;
    wxString m_strServerName;
    int64_t m_llServerVersion = -1;
    wxString m_strBaseVirtualPrinter;
    wxString m_strBaseVirtualPrinterName;
    wxString m_strBaseVirtualPrinterDisplayName;
    bool m_bEnable = false;
    InputFormats m_vInputFormats;
    bool m_bCentralized = false;
    bool m_bJobPresetAttached = false;
    bool m_bCustomInterval = false;
    wxString m_strCustomTimeInterval;
    wxString m_strSettingPath;
    wxString m_strSelectedPreset;
    wxString m_strPPDVersion;
    wxString m_strServerTypeAndJPDefaultKeyInfo;
    wxString m_strTextServerVersion;
    wxString m_strServerType;
    bool m_bQuickSetsSupported = false;
    bool m_bQuickSetsEnabled = false;
    wxString m_strSelectedQuickSet;
    bool m_bWidthBased = false;
    bool m_bJobExpertSupported = false;
    bool m_bJobExpertEnabled = false;
    std::pair<wxString, wxString> m_JobExpertRule;
};
} // namespace db
