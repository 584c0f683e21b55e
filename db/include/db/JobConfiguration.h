#pragma once
#include "db/KeyedConfiguration.h"

namespace db
{
// Job overrides: setting name to (display value, value, localised display
// value), ordered by name.
class JobConfiguration : public KeyedConfiguration<JobSettingTexts>
{
public:
    // Replaces the texts of an existing key or adds the key.
    void SaveProperty(const wxString& key, const wxString& value, const wxString& displayValue,
                      const wxString& locDisplayValue);
    // False (outputs untouched) when the key is absent.
    bool GetProperty(const wxString& key, wxString& value, wxString& displayValue,
                     wxString& locDisplayValue) const;
};
} // namespace db
