#include "db/PreflightConfiguration.h"

namespace db
{
bool PreflightConfiguration::IsPreflightEnabled() const
{
    for (const PairString& entry : m_Properties)
        if (entry.GetKey().IsSameAs("Status", false))
            return entry.GetValue().IsSameAs("true", false);
    return false;
}

void PreflightConfiguration::SetPreflightEnabled(bool enabled)
{
    const wxString value = enabled ? "true" : "false";
    for (PairString& entry : m_Properties)
        if (entry.GetKey().IsSameAs("Status", false))
        {
            entry = PairString(entry.GetKey(), value);
            return;
        }
    AddProperty("Status", value);
}
} // namespace db
