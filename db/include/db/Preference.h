#pragma once
#include <wx/string.h>

namespace db
{
// The application preferences kept in the machine-wide Preferences.cfg.
class Preference
{
public:
    // The effective unit, a translated word: follows the system's measurement
    // system while the user-changed flag says "false", else the stored unit.
    wxString GetUnit() const;
    // The unit as stored, without the system rule.
    const wxString& GetStoredUnit() const { return m_strUnit; }
    void SetUnit(const wxString& value) { m_strUnit = value; }
    const wxString& GetImpositionPresetLocation() const { return m_strImpositionPresetLocation; }
    void SetImpositionPresetLocation(const wxString& value)
    {
        m_strImpositionPresetLocation = value;
    }
    const wxString& GetTimeInterval() const { return m_strTimeInterval; }
    void SetTimeInterval(const wxString& value) { m_strTimeInterval = value; }
    const wxString& GetJobsSaveLocation() const { return m_strJobsSaveLocation; }
    void SetJobsSaveLocation(const wxString& value) { m_strJobsSaveLocation = value; }
    const wxString& GetOroginalJobClearValue() const { return m_strOriginalJobClearValue; }
    void SetOroginalJobClearValue(const wxString& value) { m_strOriginalJobClearValue = value; }
    const wxString& GetFailedJobClearValue() const { return m_strFailedJobClearValue; }
    void SetFailedJobClearValue(const wxString& value) { m_strFailedJobClearValue = value; }
    bool GetStatusCustomLocation() const { return m_bCustomLocation; }
    void SetStatusCustomLocation(bool value) { m_bCustomLocation = value; }
    bool GetStatusClearOriginal() const { return m_bClearOriginal; }
    void SetStatusClearOriginal(bool value) { m_bClearOriginal = value; }
    bool GetStatusClearFailed() const { return m_bClearFailed; }
    void SetStatusClearFailed(bool value) { m_bClearFailed = value; }
    const wxString& GetAppLang() const { return m_strAppLang; }
    void SetAppLang(const wxString& value) { m_strAppLang = value; }
    bool GetStatusAutoRefresh() const { return m_bAutoRefresh; }
    void SetStatusAutoRefresh(bool value) { m_bAutoRefresh = value; }
    const wxString& GetAutoRefreshPresetValue() const { return m_strAutoRefreshValue; }
    void SetAutoRefreshPresetValue(const wxString& value) { m_strAutoRefreshValue = value; }
    const wxString& GetUserUnitChanged() const { return m_strUserUnitChanged; }
    void SetUserUnitChanged(const wxString& value) { m_strUserUnitChanged = value; }

private:
    wxString m_strUnit;
    wxString m_strImpositionPresetLocation;
    wxString m_strTimeInterval;
    wxString m_strJobsSaveLocation;
    wxString m_strOriginalJobClearValue;
    wxString m_strFailedJobClearValue;
    bool m_bCustomLocation = false;
    bool m_bClearOriginal = false;
    bool m_bClearFailed = false;
    wxString m_strAppLang;
    bool m_bAutoRefresh = true;
    wxString m_strAutoRefreshValue = "30";
    wxString m_strUserUnitChanged;
};
} // namespace db
