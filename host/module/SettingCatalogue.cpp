#include "module/SettingCatalogue.h"

#include <cmath>

namespace
{
// Digits with at most one decimal separator, as the panels' fields take
// them: no sign, exponent, hexadecimal, infinity or "nan".
bool ParseNumber(const wxString& text, double& number)
{
    wxString dotted = text.Strip(wxString::both);
    dotted.Replace(",", "."); // a decimal comma typed by habit
    bool digit = false, separator = false;
    for (wxUniChar c : dotted)
    {
        if (c == '.' && !separator)
            separator = true;
        else if (c >= '0' && c <= '9')
            digit = true;
        else
            return false;
    }
    return digit && dotted.ToCDouble(&number) && std::isfinite(number);
}
} // namespace

bool NormaliseSettingValue(const wxString& key, const wxString& value, wxString& stored,
                           wxString& error)
{
    SettingKind kind;
    if (!LookUpSettingKind(key, kind))
    {
        error = wxString::Format("unknown setting %s (known: %s)", key,
                                 wxJoin(KnownSettingKeys(), ' '));
        return false;
    }
    double number = 0;
    switch (kind)
    {
    case SettingKind::Flag:
    {
        wxString word = value.Lower();
        if (word == FormatSettingFlag(true) || word == "yes" || word == "true" || word == "on")
            stored = FormatSettingFlag(true);
        else if (word == FormatSettingFlag(false) || word == "no" || word == "false" ||
                 word == "off")
            stored = FormatSettingFlag(false);
        else
        {
            error = wxString::Format("%s takes 1 or 0 (yes/no), not \"%s\"", key, value);
            return false;
        }
        return true;
    }
    case SettingKind::Points:
        if (!ParseNumber(value, number) || number < 0 || number > 14400)
        {
            error = wxString::Format("%s takes a length in points between 0 and 14400, not \"%s\"",
                                     key, value);
            return false;
        }
        stored = FormatSettingDouble(number);
        return true;
    case SettingKind::Length:
        if (!ParseNumber(value, number) || number <= 0)
        {
            error = wxString::Format(
                "%s takes a positive number such as 2.5 (digits and one decimal point), not \"%s\"",
                key, value);
            return false;
        }
        stored = value.Strip(wxString::both);
        stored.Replace(",", ".");
        return true;
    case SettingKind::UnitWord:
        if (value != UnitWord(UNIT_INCH) && value != UnitWord(UNIT_MM) &&
            value != UnitWord(UNIT_POINT))
        {
            error = wxString::Format("%s takes inch, mm or point, not \"%s\"", key, value);
            return false;
        }
        stored = value;
        return true;
    case SettingKind::UnitNumber:
    {
        Unit_t unit = UNIT_INCH;
        if (value.empty() || !DecodeCustomPageUnit(value, unit))
        {
            error =
                wxString::Format("%s takes 0 (inch), 1 (mm) or 2 (point), not \"%s\"", key, value);
            return false;
        }
        stored = EncodeCustomPageUnit(unit);
        return true;
    }
    case SettingKind::ImagePosition:
        for (const char* position : kImagePositionWords)
            if (value.IsSameAs(position, false))
            {
                stored = position;
                return true;
            }
        error = wxString::Format(
            "%s takes Top Left, Top Right, Center, Bottom Left or Bottom Right, not \"%s\"", key,
            value);
        return false;
    case SettingKind::PaperName:
        if (value.Strip(wxString::both).empty())
        {
            error = wxString::Format("%s needs a paper name", key);
            return false;
        }
        stored = value.Strip(wxString::both);
        return true;
    case SettingKind::Text:
        stored = value;
        return true;
    }
    return false;
}
