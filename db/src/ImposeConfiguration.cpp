#include "db/ImposeConfiguration.h"

namespace db
{
void ImposeConfiguration::SaveProperty(const wxString& key, const wxString& value,
                                       const wxString& displayValue)
{
    m_Properties[key] = PairString(value, displayValue);
}

bool ImposeConfiguration::GetProperty(const wxString& key, wxString& value,
                                      wxString& displayValue) const
{
    const PairString* texts = Find(key);
    if (!texts)
        return false;
    value = texts->GetValue();
    displayValue = texts->GetDisplayValue();
    return true;
}
} // namespace db
