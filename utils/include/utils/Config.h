#pragma once
#include <map>

#include <wx/arrstr.h>
#include <wx/string.h>

namespace utils
{
// Process-wide key/value settings shipped with the application in
// Resources/HFConfig.cfg. Built empty on first use; Initialize loads it.
class Config
{
public:
    static Config& GetInstance();

    // Loads the file. False when it is missing, does not parse or has no
    // root. Keys already known keep their values; the display key lists
    // are rebuilt.
    bool Initialize();

    // Inserts unless the key is already there.
    void AddKey(const wxString& key, const wxString& value);
    bool GetKey(const wxString& key, wxString& value) const;
    void GetJPDisplayKeys(wxArrayString& keys, wxArrayString& displayNames) const;

    static bool ReadString(const wxString& key, wxString& value);
    // The key's value as a base-10 long (0 when it does not parse). A missing
    // key gives 1 and defaultValue is ignored: existing callers depend on it.
    static long ReadLong(const wxString& key, long defaultValue);

    // The directory holding HFConfig.cfg: "Resources" beside the directory
    // of the running executable, or $HOTFOLDER_RESOURCES_DIR when set.
    static wxString GetResourcesDirectory();
    static wxString GetConfigFilePath();

    Config(const Config&) = delete;
    Config& operator=(const Config&) = delete;

private:
    Config() = default;

    std::map<wxString, wxString> m_values;
    wxArrayString m_displayKeys;
    wxArrayString m_displayNames;
};
} // namespace utils
