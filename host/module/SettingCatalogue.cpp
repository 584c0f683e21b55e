#include "module/SettingCatalogue.h"

#include <cmath>
#include <utility>

#include "SettingsKeys.h"

namespace
{
using namespace SettingsKeys;

const std::pair<const char*, SettingKind> kCatalogue[] = {
    {OUTPUTFILETYPEEPS, SettingKind::Flag},
    {OUTPUTFILETYPEPS, SettingKind::Flag},
    {CUSTOMPAGESIZE, SettingKind::Flag},
    {DEFAULTPAGESIZE, SettingKind::PaperName},
    {ORIENTATIONPOTRAIT, SettingKind::Flag},
    {ORIENTATIONLANDSCAPE, SettingKind::Flag},
    {AUTOROTATE, SettingKind::Flag},
    {IMAGEPOSITION, SettingKind::ImagePosition},
    {FORCEPAGESIZEX, SettingKind::Points},
    {FORCEPAGESIZEY, SettingKind::Points},
    {IMAGEEABLESIZELLX, SettingKind::Points},
    {IMAGEEABLESIZELLY, SettingKind::Points},
    {IMAGEEABLESIZEURX, SettingKind::Points},
    {IMAGEEABLESIZEURY, SettingKind::Points},
    {PAGESIZE_COMMAND, SettingKind::Text},
    {CUSTOMPAGEWIDTH, SettingKind::Points},
    {CUSTOMPAGEHEIGHT, SettingKind::Points},
    {CUSTOMPAGETUNIT, SettingKind::UnitNumber},
    {ORIGINALSIZE, SettingKind::Flag},
    {CUSTOMSIZE, SettingKind::Flag},
    {CONTRAINPROPORTION, SettingKind::Flag},
    {ORIGINALWIDTHOPTION, SettingKind::Flag},
    {ORIGINALHEIGHTOPTION, SettingKind::Flag},
    {ORIGINALWIDTH, SettingKind::Length},
    {ORIGINALHEIGHT, SettingKind::Length},
    {ORIGINALWIDTHUNIT, SettingKind::UnitWord},
    {ORIGINALHEIGHTUNIT, SettingKind::UnitWord},
    {FORCEAUTOSCALE, SettingKind::Flag},
    {FITTOPAGE, SettingKind::Flag},
    {SHRINKTOFIT, SettingKind::Flag},
    {SCALETOPRINT, SettingKind::Flag},
};

const char* const kImagePositions[] = {"Top Left", "Top Right", "Center", "Bottom Left",
                                       "Bottom Right"};

bool ParseNumber(const wxString& text, double& number)
{
    wxString dotted = text.Strip(wxString::both);
    dotted.Replace(",", "."); // a decimal comma typed by habit
    return !dotted.empty() && dotted.ToCDouble(&number) && std::isfinite(number);
}
} // namespace

bool LookUpSettingKind(const wxString& key, SettingKind& kind)
{
    for (const auto& entry : kCatalogue)
        if (key == entry.first)
        {
            kind = entry.second;
            return true;
        }
    return false;
}

wxArrayString KnownSettingKeys()
{
    wxArrayString keys;
    for (const auto& entry : kCatalogue)
        keys.Add(entry.first);
    return keys;
}

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
        if (word == "1" || word == "yes" || word == "true" || word == "on")
            stored = "1";
        else if (word == "0" || word == "no" || word == "false" || word == "off")
            stored = "0";
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
            error = wxString::Format("%s takes a positive number, not \"%s\"", key, value);
            return false;
        }
        stored = value.Strip(wxString::both);
        stored.Replace(",", ".");
        return true;
    case SettingKind::UnitWord:
        if (value != "inch" && value != "mm" && value != "point")
        {
            error = wxString::Format("%s takes inch, mm or point, not \"%s\"", key, value);
            return false;
        }
        stored = value;
        return true;
    case SettingKind::UnitNumber:
        if (value != "0" && value != "1" && value != "2")
        {
            error =
                wxString::Format("%s takes 0 (inch), 1 (mm) or 2 (point), not \"%s\"", key, value);
            return false;
        }
        stored = value;
        return true;
    case SettingKind::ImagePosition:
        for (const char* position : kImagePositions)
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
