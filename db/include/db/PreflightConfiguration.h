#pragma once
#include <vector>

#include <wx/string.h>

namespace db
{
// Preflight settings: (key, value) pairs in document order.
class PreflightConfiguration
{
public:
    class PairString
    {
    public:
        PairString() = default;
        PairString(const wxString& key, const wxString& value) : m_strKey(key), m_strValue(value) {}
        const wxString& GetKey() const { return m_strKey; }
        const wxString& GetValue() const { return m_strValue; }
        bool operator==(const PairString& other) const
        {
            return m_strKey == other.m_strKey && m_strValue == other.m_strValue;
        }

    private:
        wxString m_strKey;
        wxString m_strValue;
    };
    using List = std::vector<PairString>;

    const List& GetProperties() const { return m_Properties; }
    void SetProperties(const List& properties) { m_Properties = properties; }
    void AddProperty(const wxString& key, const wxString& value)
    {
        m_Properties.emplace_back(key, value);
    }

    // True when the first entry keyed "Status" (any case) holds "true" (any case).
    bool IsPreflightEnabled() const;
    // Sets that entry to "true" or "false", keeping its key as spelt and
    // every other entry; adds a "Status" entry at the end when there is none.
    void SetPreflightEnabled(bool enabled);

private:
    List m_Properties;
};
} // namespace db
