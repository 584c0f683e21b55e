#include "utils/HFHelper.h"

#include <clocale>
#include <langinfo.h>

#include <wx/utils.h>

wxString HFHelper::GetSystemMeasurementUnit()
{
    // The system's measurement setting comes from the environment's
    // LC_MEASUREMENT (LC_ALL, LC_MEASUREMENT, LANG), not from whatever the
    // process's C locale currently is.
    locale_t loc = newlocale(LC_MEASUREMENT_MASK, "", static_cast<locale_t>(0));
    if (loc == static_cast<locale_t>(0))
        loc = newlocale(LC_MEASUREMENT_MASK, "C", static_cast<locale_t>(0));
    // glibc answers 1 for metric and 2 for US customary units.
    const char* value = nl_langinfo_l(_NL_MEASUREMENT_MEASUREMENT, loc);
    const bool metric = value && value[0] == 1;
    freelocale(loc);
    return metric ? "0" : "1";
}
