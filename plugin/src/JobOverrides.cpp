// The chosen page size, handed to the print server through Folder.cfg.
#include "EPS.h"
#include "db/HFDatabase.h"

bool EPS::WriteJobOverrides(wxString folder)
{
    // Indexing adds the key with an empty value when it is absent, and the
    // map is saved as it stands: kept so that saved preferences do not change.
    (void)m_settings["PAGESIZE_COMMAND"];
    if (m_lStatus != 0)
        return true;

    wxArrayString keys, values;
    if (!m_bOutputTypeIsOne)
    {
        wxString pageSize = m_settings["DEFAULTPAGESIZE"];
        if (m_settings["CUSTOMPAGESIZE"] == "1")
        {
            keys.Add("PageSize");
            values.Add("Custom");
            keys.Add("CustomPageSize");
            values.Add(m_settings["FORCEPAGESIZEX"] + " " + m_settings["FORCEPAGESIZEY"]);
        }
        else
        {
            keys.Add("PageSize");
            values.Add(pageSize.Trim(true));
        }
    }

    if (!keys.empty())
        db::HFDatabase::WriteJobOverrides(folder, keys, values);
    return true;
}
