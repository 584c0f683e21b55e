#pragma once
#include <map>

#include <wx/string.h>

namespace db
{
// Imposition settings: setting name to (display value, value), ordered by name.
class ImposeConfiguration
{
public:
    class PairString
    {
    public:
        PairString() = default;
        PairString(const wxString& value, const wxString& displayValue)
            : m_strDisplayValue(displayValue), m_strValue(value)
        {
        }
        const wxString& GetDisplayValue() const { return m_strDisplayValue; }
        const wxString& GetValue() const { return m_strValue; }
        bool operator==(const PairString& other) const
        {
            return m_strDisplayValue == other.m_strDisplayValue && m_strValue == other.m_strValue;
        }

    private:
        wxString m_strDisplayValue;
        wxString m_strValue;
    };
    using Map = std::map<wxString, PairString>;

    void SaveProperty(const wxString& key, const wxString& value, const wxString& displayValue);
    bool GetProperty(const wxString& key, wxString& value, wxString& displayValue) const;
    void RemoveProperty(const wxString& key);
    void RemoveAll();
    void GetProperties(Map& properties) const;
    void SetProperties(const Map& properties);
    const Map& GetProperties() const { return m_Properties; }

    void WriteToString(wxString& out) const;

private:
    Map m_Properties;
};
} // namespace db
