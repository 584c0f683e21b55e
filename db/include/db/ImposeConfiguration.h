#pragma once
#include "db/KeyedConfiguration.h"

namespace db
{
// Imposition settings: setting name to (display value, value), ordered by name.
class ImposeConfiguration : public KeyedConfiguration<SettingTexts>
{
public:
    // Replaces the texts of an existing key or adds the key.
    void SaveProperty(const wxString& key, const wxString& value, const wxString& displayValue);
    // False (outputs untouched) when the key is absent.
    bool GetProperty(const wxString& key, wxString& value, wxString& displayValue) const;
};
} // namespace db
