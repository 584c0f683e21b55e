#pragma once
#include <wx/string.h>
#include "EPStoPSparams.h"

FilterImgPosition_t ConvertToImgPos(ImagePosition_t position);
ImagePosition_t ConvertFromImgPos(FilterImgPosition_t position);

// The position stored in the settings as its (possibly translated) display
// word, back to the converter's numbering; unknown text is the centre.
uint32_t ConvertToImgPosStr(const wxString& text);
