#include "SizeKeystrokeFilter.h"

#include <algorithm>

#include <wx/wxcrt.h>

#include "utils/CLocaleNumbers.h"

namespace
{
SizeKeystrokeResult RemoveTypedCharacter(SizeKeystrokeResult result)
{
    result.text.erase(result.insertion - 1, 1);
    --result.insertion;
    result.changed = true;
    return result;
}
} // namespace

bool IsSeparatorAlreadyEntered(const wxString& text, const wxString& separator)
{
    return !separator.empty() && text.Freq(separator[0]) >= 2;
}

double ParseSizeField(const wxString& text, const wxString& decimalPoint)
{
    wxString plain = text;
    if (!decimalPoint.empty() && decimalPoint != ".")
        plain.Replace(decimalPoint, ".");
    return utils::StrToDoubleC(plain);
}

SizeKeystrokeResult FilterSizeKeystroke(const wxString& text, long insertion,
                                        const wxString& decimalPoint, double maximum,
                                        const wxString& lastAccepted)
{
    SizeKeystrokeResult result;
    result.text = text;
    result.insertion = std::min<long>(std::max<long>(insertion, 0), text.length());
    result.lastAccepted = lastAccepted;

    const bool hasTyped = result.insertion > 0;
    const wxUniChar typed = hasTyped ? text[result.insertion - 1] : wxUniChar(' ');
    const bool typedSeparator = hasTyped && !decimalPoint.empty() && typed == decimalPoint[0];
    if (hasTyped && !typedSeparator && !wxIsdigit(typed))
        return RemoveTypedCharacter(result);
    if (typedSeparator)
    {
        if (IsSeparatorAlreadyEntered(text, decimalPoint))
            return RemoveTypedCharacter(result);
        return result;
    }

    if (ParseSizeField(text, decimalPoint) > maximum)
    {
        result.text = lastAccepted;
        result.insertion =
            std::max<long>(0, std::min<long>(result.insertion - 1, lastAccepted.length()));
        result.changed = true;
        return result;
    }
    result.lastAccepted = text;

    const int point = decimalPoint.empty() ? wxNOT_FOUND : text.Find(decimalPoint[0]);
    if (hasTyped && point != wxNOT_FOUND && text.length() - point - 1 >= 3)
        return RemoveTypedCharacter(result);
    return result;
}
