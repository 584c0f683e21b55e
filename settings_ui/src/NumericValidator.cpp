#include "NumericValidator.h"

NumericValidator::NumericValidator(wxString* value, const wxString& decimalSeparator)
    : wxTextValidator(wxFILTER_NUMERIC | wxFILTER_EXCLUDE_CHAR_LIST, value)
{
    SetCharExcludes(ExcludedCharacters(decimalSeparator));
}

wxString NumericValidator::ExcludedCharacters(const wxString& decimalSeparator)
{
    // The numeric filter alone lets signs, exponents and both separators
    // through.
    wxString excluded = "+-eE";
    excluded += decimalSeparator.CmpNoCase(".") != 0 ? "." : ",";
    return excluded;
}
