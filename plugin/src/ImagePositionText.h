#pragma once
#include <cstdint>

#include <wx/string.h>

// The position stored in the settings as its (possibly translated) display
// word, back to the converter's numbering (an ImagePosition_t); unknown text
// is the centre.
uint32_t ConvertToImgPosStr(const wxString& text);
