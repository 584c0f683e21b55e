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
    const auto found = m_Properties.find(key);
    if (found == m_Properties.end())
        return false;
    value = found->second.GetValue();
    displayValue = found->second.GetDisplayValue();
    return true;
}

void ImposeConfiguration::RemoveProperty(const wxString& key)
{
    m_Properties.erase(key);
}

void ImposeConfiguration::RemoveAll()
{
    m_Properties.clear();
}

void ImposeConfiguration::GetProperties(Map& properties) const
{
    properties = m_Properties;
}

void ImposeConfiguration::SetProperties(const Map& properties)
{
    m_Properties = properties;
}

void ImposeConfiguration::WriteToString(wxString& out) const
{
    for (const auto& entry : m_Properties)
        out +=
            wxString::Format("<Key name=\"%s\" value=\"%s\" displayvalue=\"%s\"/>\n", entry.first,
                             entry.second.GetValue(), entry.second.GetDisplayValue());
}
} // namespace db
