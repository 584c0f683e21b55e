#include "SettingsKeys.h"

#include "utils/CLocaleNumbers.h"

wxString FormatSettingFlag(bool on)
{
    return on ? "1" : "0";
}

bool IsSettingOn(const wxString& value)
{
    return value == "1";
}

bool ReadSettingFlag(MapPropToValue& settings, const wxString& key, bool defaultValue)
{
    const wxString& value = settings[key];
    return value.empty() ? defaultValue : IsSettingOn(value);
}

wxString FormatSettingDouble(double value)
{
    return utils::FormatFixedC(value, 6);
}

wxString FormatSettingInt(long value)
{
    return wxString::Format("%ld", value);
}

bool ParseSettingDouble(const wxString& text, double& value)
{
    bool complete = false;
    value = utils::StrToDoubleC(text, &complete);
    return complete;
}

bool ReadOutputFileTypePS(MapPropToValue& settings)
{
    const wxString& ps = settings[SettingsKeys::OUTPUTFILETYPEPS];
    if (!ps.empty())
        return IsSettingOn(ps);
    const wxString& eps = settings[SettingsKeys::OUTPUTFILETYPEEPS];
    return eps.empty() ? false : !IsSettingOn(eps);
}

bool DecodeCustomPageUnit(const wxString& value, Unit_t& unit)
{
    if (value.empty() || value == "0")
        unit = UNIT_INCH;
    else if (value == "1")
        unit = UNIT_MM;
    else if (value == "2")
        unit = UNIT_POINT;
    else
        return false;
    return true;
}

wxString DefaultOriginalDimension(bool fieldUnitIsInch)
{
    return fieldUnitIsInch ? "0.25" : "6.35";
}
