#pragma once
#include <cstdint>

#include <wx/string.h>

// Length units of the settings panels. Stored in the settings map as the
// decimal number of the enumerator.
enum Unit_t : int32_t
{
    UNIT_INCH = 0,
    UNIT_MM = 1,
    UNIT_POINT = 2
};

// The two units of GetValueInUnits, related by the factor 2.54.
enum Unit2_t : int32_t
{
    UNIT2_CM = 0,
    UNIT2_INCH = 1
};

constexpr double kPointsPerInch = 72.0;
constexpr double kMillimetresPerInch = 25.4;

// Converts in place. False only for an unusable source unit when converting
// to inch or point; a bad source towards millimetre is ignored (true).
bool convertToUnit(double& value, Unit_t from, Unit_t to);

// Drops the fraction when the third decimal digit is 6 or more
// (8.506 -> 8, 8.505 stays). Returns its argument.
double& AdjustValue(double& value);

// 0 -> 1 divides by 2.54, 1 -> 0 multiplies. False for a source other
// than 0 or 1.
bool GetValueInUnits(double& value, Unit2_t from, Unit2_t to);

// "8.50in", "215.90mm", "612.00pt" (any unit other than inch and mm prints
// as points). Always with "." because the text can be stored as a page size.
wxString formatUnit(double value, Unit_t unit);

// The unit's English word: "inch", "mm" or "point". The server names its
// preferred unit so, and the panels show and store its translation.
const char* UnitWord(Unit_t unit);

// Unit of the server's preference word; any other word gives inch.
Unit_t UnitFromServerWord(const wxString& word);
