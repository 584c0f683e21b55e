#include "db/Preference.h"

#include "hotfolder/HFTranslations.h"
#include "utils/HFHelper.h"

namespace db
{
wxString Preference::GetUnit() const
{
    wxString derived;
    // Until the user picks a unit the flag says "false" and the system's
    // measurement system decides.
    if (!m_strUserUnitChanged.empty() && m_strUserUnitChanged.IsSameAs("false", false))
    {
        const bool metric = HFHelper::GetSystemMeasurementUnit() == "0";
        derived = HFTranslations::GetInstance()->Translate(metric ? "mm" : "inch");
    }
    return derived.empty() ? m_strUnit : derived;
}
} // namespace db
