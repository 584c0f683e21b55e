#include "PageSizeKeys.h"

#include "SettingsKeys.h"

using namespace SettingsKeys;

namespace
{
int WholePointsAsWritten(const wxString& written)
{
    double points = 0;
    ParseSettingDouble(written, points);
    return static_cast<int>(points);
}
} // namespace

const stPageAttribute* FindSheetByDisplayName(const std::vector<stPageAttribute>& sheets,
                                              const wxString& displayName)
{
    for (const auto& sheet : sheets)
        if (sheet.PaperDisplayName == displayName)
            return &sheet;
    return nullptr;
}

const stPageAttribute* FindSheetByPaperName(const std::vector<stPageAttribute>& sheets,
                                            const wxString& paperName)
{
    for (const auto& sheet : sheets)
        if (sheet.PaperName == paperName)
            return &sheet;
    return nullptr;
}

void WriteSheetPageKeys(MapPropToValue& settings, const stPageAttribute& sheet)
{
    settings[FORCEPAGESIZEX] = FormatSettingDouble(sheet.Width);
    settings[FORCEPAGESIZEY] = FormatSettingDouble(sheet.Height);
    settings[IMAGEEABLESIZELLX] = FormatSettingDouble(sheet.Left);
    settings[IMAGEEABLESIZELLY] = FormatSettingDouble(sheet.Top);
    settings[IMAGEEABLESIZEURX] = FormatSettingDouble(sheet.Right);
    settings[IMAGEEABLESIZEURY] = FormatSettingDouble(sheet.Bottom);
    settings[PAGESIZE_COMMAND] = sheet.PSCommand;
}

void WriteCustomPageKeys(MapPropToValue& settings, double widthPoints, double heightPoints,
                         const stCustomPageSizeAttribute& custom, Unit_t unit)
{
    settings[FORCEPAGESIZEX] = FormatSettingDouble(widthPoints);
    settings[FORCEPAGESIZEY] = FormatSettingDouble(heightPoints);
    settings[IMAGEEABLESIZELLX] = FormatSettingInt(custom.LeftHWMargin);
    settings[IMAGEEABLESIZELLY] = FormatSettingInt(custom.BottomHWMargin);
    settings[IMAGEEABLESIZEURX] = FormatSettingDouble(widthPoints - custom.RightHWMargin);
    settings[IMAGEEABLESIZEURY] = FormatSettingDouble(heightPoints - custom.TopHWMargin);
    settings[CUSTOMPAGEWIDTH] = FormatSettingDouble(widthPoints);
    settings[CUSTOMPAGEHEIGHT] = FormatSettingDouble(heightPoints);
    settings[CUSTOMPAGETUNIT] = EncodeCustomPageUnit(unit);
    settings[CUSTOMPAGESIZE] = FormatSettingFlag(true);
    // The device takes whole points; truncation, not rounding, is what it
    // expects. It truncates the size as written above, so that a size a hair
    // below a whole point (864 pt typed in millimetres) asks for the 864 the
    // forced size says, not for 863.
    settings[PAGESIZE_COMMAND] =
        wxString::Format("\n%d %d 0 0 1", WholePointsAsWritten(settings[FORCEPAGESIZEX]),
                         WholePointsAsWritten(settings[FORCEPAGESIZEY])) +
        custom.command;
}

wxString CustomPageEntryText(double width, double height, Unit_t unit)
{
    return formatUnit(width, unit) + " x " + formatUnit(height, unit);
}
