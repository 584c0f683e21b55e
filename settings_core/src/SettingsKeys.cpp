#include "SettingsKeys.h"

#include <utility>

#include <hotfolder/HFTranslations.h>

#include "utils/CLocaleNumbers.h"

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

double ReadSettingNumber(MapPropToValue& settings, const wxString& key)
{
    const wxString& text = settings[key];
    double value = 0;
    if (!text.ToCDouble(&value) && !text.ToDouble(&value))
        value = 0;
    return value;
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

wxString EncodeCustomPageUnit(Unit_t unit)
{
    return FormatSettingInt(unit);
}

Unit_t DecodeDimensionUnit(const wxString& storedWord)
{
    const HFTranslations* translations = HFTranslations::GetInstance();
    for (Unit_t unit : {UNIT_INCH, UNIT_MM})
        if (translations->GetTranslations(UnitWord(unit)).Index(storedWord, true) != wxNOT_FOUND)
            return unit;
    return UNIT_POINT;
}

wxString DefaultOriginalDimension(bool fieldUnitIsInch)
{
    return fieldUnitIsInch ? "0.25" : "6.35";
}
