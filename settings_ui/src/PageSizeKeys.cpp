#include "PageSizeKeys.h"

#include "utils/CLocaleNumbers.h"

namespace
{
wxString Points(double value)
{
    return utils::FormatFixedC(value, 6);
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
    settings["FORCEPAGESIZEX"] = Points(sheet.Width);
    settings["FORCEPAGESIZEY"] = Points(sheet.Height);
    settings["IMAGEEABLESIZELLX"] = Points(sheet.Left);
    settings["IMAGEEABLESIZELLY"] = Points(sheet.Top);
    settings["IMAGEEABLESIZEURX"] = Points(sheet.Right);
    settings["IMAGEEABLESIZEURY"] = Points(sheet.Bottom);
    settings["PAGESIZE_COMMAND"] = sheet.PSCommand;
}

void WriteCustomPageKeys(MapPropToValue& settings, double widthPoints, double heightPoints,
                         const stCustomPageSizeAttribute& custom, Unit_t unit)
{
    settings["FORCEPAGESIZEX"] = Points(widthPoints);
    settings["FORCEPAGESIZEY"] = Points(heightPoints);
    settings["IMAGEEABLESIZELLX"] = wxString::Format("%d", custom.LeftHWMargin);
    settings["IMAGEEABLESIZELLY"] = wxString::Format("%d", custom.BottomHWMargin);
    settings["IMAGEEABLESIZEURX"] = Points(widthPoints - custom.RightHWMargin);
    settings["IMAGEEABLESIZEURY"] = Points(heightPoints - custom.TopHWMargin);
    settings["CUSTOMPAGEWIDTH"] = Points(widthPoints);
    settings["CUSTOMPAGEHEIGHT"] = Points(heightPoints);
    settings["CUSTOMPAGETUNIT"] = wxString::Format("%d", static_cast<int>(unit));
    settings["CUSTOMPAGESIZE"] = "1";
    // The device takes whole points; truncation, not rounding, is what it expects.
    settings["PAGESIZE_COMMAND"] = wxString::Format("\n%d %d 0 0 1", static_cast<int>(widthPoints),
                                                    static_cast<int>(heightPoints)) +
                                   custom.command;
}

wxString CustomPageEntryText(double width, double height, Unit_t unit)
{
    return formatUnit(width, unit) + " x " + formatUnit(height, unit);
}
