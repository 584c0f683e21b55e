#pragma once
#include <wx/hashmap.h>
#include <wx/string.h>

// Filter settings: key to text value. Indexing inserts an empty value for
// an absent key, so readers treat empty as absent.
WX_DECLARE_STRING_HASH_MAP(wxString, MapPropToValue);
