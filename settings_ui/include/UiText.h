#pragma once
#include <wx/arrstr.h>
#include <wx/string.h>

// The host's translation of an English source text (the text itself when
// the selected catalogue has none).
wxString TranslateUiText(const wxString& english);

// Replaces, for each index in order, the first occurrence of the
// placeholder by its replacement; only when both lists have the same
// non-zero length.
void ReplacePlaceHolderString(wxString& message, const wxArrayString& placeholders,
                              const wxArrayString& replacements);
