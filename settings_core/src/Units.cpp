#include "Units.h"

#include <cmath>
#include <cstdint>
#include <limits>

#include "utils/CLocaleNumbers.h"

bool convertToUnit(double& value, Unit_t from, Unit_t to)
{
    if (from == to)
        return true;
    switch (to)
    {
    case UNIT_INCH:
        if (from == UNIT_MM)
            value /= kMillimetresPerInch;
        else if (from == UNIT_POINT)
            value /= kPointsPerInch;
        else
            return false;
        return true;
    case UNIT_MM:
        // An unknown source is silently ignored towards millimetres; callers
        // have always relied on that.
        if (from == UNIT_INCH)
            value *= kMillimetresPerInch;
        else if (from == UNIT_POINT)
            value = value / kPointsPerInch * kMillimetresPerInch;
        return true;
    case UNIT_POINT:
        if (from == UNIT_MM)
            value = value / kMillimetresPerInch * kPointsPerInch;
        else if (from == UNIT_INCH)
            value *= kPointsPerInch;
        else
            return false;
        return true;
    }
    return true;
}

double& AdjustValue(double& value)
{
    const double scaled = std::trunc(value * 1000.0);
    // Beyond 32 bits the historic integer arithmetic has no defined result;
    // leave such values alone.
    if (!(scaled >= std::numeric_limits<int32_t>::min() &&
          scaled <= std::numeric_limits<int32_t>::max()))
        return value;
    const int64_t n = static_cast<int32_t>(scaled);
    if (n % 10 < 6)
        return value;
    value = static_cast<double>((n + 5) / 1000);
    return value;
}

bool GetValueInUnits(double& value, Unit2_t from, Unit2_t to)
{
    if (from == UNIT2_CM && to == UNIT2_INCH)
        value /= 2.54;
    else if (from == UNIT2_INCH && to == UNIT2_CM)
        value *= 2.54;
    return from == UNIT2_CM || from == UNIT2_INCH;
}

wxString formatUnit(double value, Unit_t unit)
{
    const char* suffix = unit == UNIT_MM ? "mm" : unit == UNIT_INCH ? "in" : "pt";
    return utils::FormatFixedC(value, 2) + suffix;
}

const char* UnitWord(Unit_t unit)
{
    return unit == UNIT_MM ? "mm" : unit == UNIT_POINT ? "point" : "inch";
}

Unit_t UnitFromServerWord(const wxString& word)
{
    for (Unit_t unit : {UNIT_MM, UNIT_POINT})
        if (word == UnitWord(unit))
            return unit;
    return UNIT_INCH;
}
