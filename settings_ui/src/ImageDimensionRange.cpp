#include "ImageDimensionRange.h"

#include "UiText.h"
#include "Units.h"

ImageDimensionCheck CheckImageDimension(double value, const wxString& unitText)
{
    ImageDimensionCheck check;
    // The mm limits are not the inch limits converted; that is what the
    // engine has always accepted.
    if (unitText.IsSameAs(TranslateUiText(UnitWord(UNIT_INCH)), false))
    {
        check.valid = value >= 0.25 && value <= 48;
        if (!check.valid)
        {
            check.rangeText = "(0.25in - 48in)";
            check.resetText = TranslateUiText("0.25");
        }
    }
    else if (unitText.IsSameAs(TranslateUiText(UnitWord(UNIT_MM)), false))
    {
        check.valid = value >= 5 && value <= 1220;
        if (!check.valid)
        {
            check.rangeText = TranslateUiText("(5mm - 1220mm)");
            check.resetText = TranslateUiText("5");
        }
    }
    return check;
}

wxString ExchangeDecimalSeparator(const wxString& text, const wxString& separator, bool toStorage)
{
    wxString result = text;
    if (separator.empty() || separator == ".")
        return result;
    if (toStorage)
        result.Replace(separator, ".");
    else
        result.Replace(".", separator);
    return result;
}
