#pragma once
#include <wx/string.h>

// What the custom page size fields make of the text after one keystroke:
// no letters, one decimal point, at most two decimals, never above the
// maximum. Plain data so it can be checked without a dialog.
struct SizeKeystrokeResult
{
    wxString text;         // what the field shows afterwards
    long insertion = 0;    // where the caret goes
    wxString lastAccepted; // the text to fall back to on the next overflow
    bool changed = false;  // the keystroke was (partly) undone
};

// `insertion` is the caret after the keystroke; `decimalPoint` the
// locale's separator the field is typed with.
SizeKeystrokeResult FilterSizeKeystroke(const wxString& text, long insertion,
                                        const wxString& decimalPoint, double maximum,
                                        const wxString& lastAccepted);

// Occurs the separator at least twice?
bool IsSeparatorAlreadyEntered(const wxString& text, const wxString& separator);

// The field's number, typed with `decimalPoint`; 0 when there is none.
double ParseSizeField(const wxString& text, const wxString& decimalPoint);
