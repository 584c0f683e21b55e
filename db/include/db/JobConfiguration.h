#pragma once
#include <map>

#include <wx/string.h>

namespace db
{
// Job overrides: setting name to (display value, value, localised display
// value), ordered by name.
class JobConfiguration
{
public:
    class PairString
    {
    public:
        PairString() = default;
        PairString(const wxString& value, const wxString& displayValue,
                   const wxString& locDisplayValue)
            : m_strDisplayValue(displayValue), m_strValue(value),
              m_strLocDisplayValue(locDisplayValue)
        {
        }
        const wxString& GetDisplayValue() const { return m_strDisplayValue; }
        const wxString& GetValue() const { return m_strValue; }
        const wxString& GetLocDisplayValue() const { return m_strLocDisplayValue; }
        bool operator==(const PairString& other) const
        {
            return m_strDisplayValue == other.m_strDisplayValue && m_strValue == other.m_strValue &&
                   m_strLocDisplayValue == other.m_strLocDisplayValue;
        }

    private:
        wxString m_strDisplayValue;
        wxString m_strValue;
        wxString m_strLocDisplayValue;
    };
    using Map = std::map<wxString, PairString>;

    // Replaces the texts of an existing key or adds the key.
    void SaveProperty(const wxString& key, const wxString& value, const wxString& displayValue,
                      const wxString& locDisplayValue);
    // False (outputs untouched) when the key is absent.
    bool GetProperty(const wxString& key, wxString& value, wxString& displayValue,
                     wxString& locDisplayValue) const;
    void RemoveProperty(const wxString& key);
    void RemoveAll();
    void GetProperties(Map& properties) const;
    void SetProperties(const Map& properties);
    const Map& GetProperties() const { return m_Properties; }

    // Appends one "<Key name=... value=... displayvalue=.../>" line per entry.
    void WriteToString(wxString& out) const;

private:
    Map m_Properties;
};
} // namespace db
