#pragma once
#include <wx/string.h>
#include <wx/valtext.h>

// Text validator for the dimension fields: digits and the decimal separator
// of the application language only, never a sign or an exponent.
class NumericValidator : public wxTextValidator
{
public:
    // value: the string the field is bound to; decimalSeparator: "." or ",".
    NumericValidator(wxString* value, const wxString& decimalSeparator);

    wxObject* Clone() const override { return new NumericValidator(*this); }

    // The characters refused on top of the numeric filter, in this order:
    // "+-eE" and then the separator that is not the given one.
    static wxString ExcludedCharacters(const wxString& decimalSeparator);
};
