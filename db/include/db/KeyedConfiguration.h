#pragma once
#include <map>

#include <wx/string.h>

namespace db
{
// The texts stored for one setting of a folder's imposition: the value as
// shown to the user and the value itself.
class SettingTexts
{
public:
    SettingTexts() = default;
    SettingTexts(const wxString& value, const wxString& displayValue)
        : m_strDisplayValue(displayValue), m_strValue(value)
    {
    }
    const wxString& GetDisplayValue() const { return m_strDisplayValue; }
    const wxString& GetValue() const { return m_strValue; }
    bool operator==(const SettingTexts& other) const
    {
        return m_strDisplayValue == other.m_strDisplayValue && m_strValue == other.m_strValue;
    }

private:
    wxString m_strDisplayValue;
    wxString m_strValue;
};

// A job override also keeps the display value in the user's language.
class JobSettingTexts : public SettingTexts
{
public:
    JobSettingTexts() = default;
    JobSettingTexts(const wxString& value, const wxString& displayValue,
                    const wxString& locDisplayValue)
        : SettingTexts(value, displayValue), m_strLocDisplayValue(locDisplayValue)
    {
    }
    const wxString& GetLocDisplayValue() const { return m_strLocDisplayValue; }
    bool operator==(const JobSettingTexts& other) const
    {
        return SettingTexts::operator==(other) &&
               m_strLocDisplayValue == other.m_strLocDisplayValue;
    }

private:
    wxString m_strLocDisplayValue;
};

// A block of a folder's configuration kept as setting name to texts, ordered
// by name (case-sensitive). The job overrides and the imposition settings
// differ only in the texts they keep per setting.
template <typename Texts> class KeyedConfiguration
{
public:
    using PairString = Texts;
    using Map = std::map<wxString, Texts>;

    void RemoveProperty(const wxString& key) { m_Properties.erase(key); }
    void RemoveAll() { m_Properties.clear(); }
    void GetProperties(Map& properties) const { properties = m_Properties; }
    void SetProperties(const Map& properties) { m_Properties = properties; }
    const Map& GetProperties() const { return m_Properties; }

    // Appends one "<Key name=... value=... displayvalue=.../>" line per entry.
    void WriteToString(wxString& out) const
    {
        for (const auto& entry : m_Properties)
            out += wxString::Format("<Key name=\"%s\" value=\"%s\" displayvalue=\"%s\"/>\n",
                                    entry.first, entry.second.GetValue(),
                                    entry.second.GetDisplayValue());
    }

protected:
    // The texts stored for key, or null.
    const Texts* Find(const wxString& key) const
    {
        const auto found = m_Properties.find(key);
        return found == m_Properties.end() ? nullptr : &found->second;
    }

    Map m_Properties;
};
} // namespace db
