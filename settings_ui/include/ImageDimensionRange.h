#pragma once
#include <wx/string.h>

// Range check of a custom image width or height in its unit text (the
// translated "inch" or "mm"). Other units are not checked.
struct ImageDimensionCheck
{
    bool valid = true;
    wxString rangeText; // for the message, when invalid
    wxString resetText; // what the field falls back to, when invalid
};

ImageDimensionCheck CheckImageDimension(double value, const wxString& unitText);

// "8,5" <-> "8.5": toStorage turns the separator into "."; otherwise the
// reverse. A "." separator leaves the text as it is.
wxString ExchangeDecimalSeparator(const wxString& text, const wxString& separator, bool toStorage);
