#pragma once
#include <wx/string.h>

// Number text that files and the print server exchange: always "." as the
// decimal point, whatever the process locale currently is (the application
// language switches the C locale at run time).
namespace utils
{
// Like strtod under the "C" locale: the value of the longest leading
// number, 0 when the text does not start with one. *complete (optional)
// tells whether the whole text, trailing white space aside, was a number.
double StrToDoubleC(const wxString& text, bool* complete = nullptr);

// Like strtol in base 10 under the "C" locale.
long StrToLongC(const wxString& text, bool* complete = nullptr);

// Like printf("%.*f") under the "C" locale: FormatFixedC(595.5, 6) is
// "595.500000".
wxString FormatFixedC(double value, int decimals);
} // namespace utils
