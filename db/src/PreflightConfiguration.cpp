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
} // namespace db
