#pragma once
// The two numberings of the five image positions. The settings word of a
// position is read by the filter's settings loading, not here.
#include "EPStoPSparams.h"

FilterImgPosition_t ConvertToImgPos(ImagePosition_t position);
ImagePosition_t ConvertFromImgPos(FilterImgPosition_t position);
