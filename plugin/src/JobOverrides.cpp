// The chosen page size, handed to the print server through Folder.cfg.
#include <wx/filename.h>

#include "EPS.h"
#include "SettingsKeys.h"
#include "db/ConfigurationReader.h"
#include "db/HFDatabase.h"
#include "db/JobConfiguration.h"

bool EPS::WriteJobOverrides(wxString folder)
{
    using namespace SettingsKeys;
    // Indexing inserts the key with an empty value, so the saved preferences
    // always carry a page size command, written by a panel or not.
    (void)m_settings[PAGESIZE_COMMAND];
    if (m_lStatus != 0)
        return true;

    wxArrayString keys, values;
    if (!m_bOutputTypeIsOne)
    {
        wxString pageSize = m_settings[DEFAULTPAGESIZE];
        if (IsSettingOn(m_settings[CUSTOMPAGESIZE]))
        {
            keys.Add("PageSize");
            values.Add("Custom");
            keys.Add("CustomPageSize");
            values.Add(m_settings[FORCEPAGESIZEX] + " " + m_settings[FORCEPAGESIZEY]);
        }
        else
        {
            keys.Add("PageSize");
            values.Add(pageSize.Trim(true));
        }
    }

    // The folder's own overrides are consulted for "RvUseAPPE", as the filter
    // always has; what it says does not change what this filter writes.
    const wxString configPath = wxFileName(folder, "Folder", "cfg").GetFullPath();
    db::JobConfiguration jobConfiguration;
    db::ConfigurationReader::ReadJobConfiguration(configPath, jobConfiguration);
    for (const auto& entry : jobConfiguration.GetProperties())
    {
        if (entry.first.ToStdString() == "RvUseAPPE")
        {
            (void)entry.second.GetValue().IsSameAs("True", false);
            break;
        }
    }

    if (!keys.empty())
        db::HFDatabase::WriteJobOverrides(folder, keys, values);
    return true;
}
