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
    const auto found = m_Properties.find(key);
    if (found == m_Properties.end())
        return false;
    value = found->second.GetValue();
    displayValue = found->second.GetDisplayValue();
    locDisplayValue = found->second.GetLocDisplayValue();
    return true;
}

void JobConfiguration::RemoveProperty(const wxString& key)
{
    m_Properties.erase(key);
}

void JobConfiguration::RemoveAll()
{
    m_Properties.clear();
}

void JobConfiguration::GetProperties(Map& properties) const
{
    properties = m_Properties;
}

void JobConfiguration::SetProperties(const Map& properties)
{
    m_Properties = properties;
}

void JobConfiguration::WriteToString(wxString& out) const
{
    for (const auto& entry : m_Properties)
        out +=
            wxString::Format("<Key name=\"%s\" value=\"%s\" displayvalue=\"%s\"/>\n", entry.first,
                             entry.second.GetValue(), entry.second.GetDisplayValue());
}
} // namespace db
