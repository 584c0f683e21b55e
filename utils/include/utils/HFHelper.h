#pragma once
#include <wx/string.h>

// Client-wide helpers: measurement system, application language.
class HFHelper
{
public:
    // "0" when the C library's LC_MEASUREMENT says metric, else "1".
    static wxString GetSystemMeasurementUnit();
};
