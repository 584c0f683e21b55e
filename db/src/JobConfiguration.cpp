#include "db/JobConfiguration.h"

namespace db
{
void JobConfiguration::SaveProperty(const wxString& key, const wxString& value,
                                    const wxString& displayValue, const wxString& locDisplayValue)
{
    m_Properties[key] = PairString(value, displayValue, locDisplayValue);
}

bool JobConfiguration::GetProperty(const wxString& key, wxString& value, wxString& displayValue,
                                   wxString& locDisplayValue) const
{
    const PairString* texts = Find(key);
    if (!texts)
        return false;
    value = texts->GetValue();
    displayValue = texts->GetDisplayValue();
    locDisplayValue = texts->GetLocDisplayValue();
    return true;
}
} // namespace db
