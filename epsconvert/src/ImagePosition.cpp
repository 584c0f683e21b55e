#include "ImagePosition.h"

FilterImgPosition_t ConvertToImgPos(ImagePosition_t position)
{
    static const FilterImgPosition_t table[] = {
        FILTER_IMG_POS_BOTTOM_LEFT,  // IMG_POS_BOTTOM_LEFT
        FILTER_IMG_POS_TOP_LEFT,     // IMG_POS_TOP_LEFT
        FILTER_IMG_POS_TOP_RIGHT,    // IMG_POS_TOP_RIGHT
        FILTER_IMG_POS_BOTTOM_RIGHT, // IMG_POS_BOTTOM_RIGHT
        FILTER_IMG_POS_CENTER,       // IMG_POS_CENTER
    };
    // Out of range maps to top right, not to the centre: kept as hosts expect.
    return position <= IMG_POS_CENTER ? table[position] : FILTER_IMG_POS_TOP_RIGHT;
}

ImagePosition_t ConvertFromImgPos(FilterImgPosition_t position)
{
    static const ImagePosition_t table[] = {
        IMG_POS_CENTER,       // FILTER_IMG_POS_CENTER
        IMG_POS_BOTTOM_LEFT,  // FILTER_IMG_POS_BOTTOM_LEFT
        IMG_POS_TOP_LEFT,     // FILTER_IMG_POS_TOP_LEFT
        IMG_POS_BOTTOM_RIGHT, // FILTER_IMG_POS_BOTTOM_RIGHT
    };
    // Top right is reached through the default only.
    return position <= FILTER_IMG_POS_BOTTOM_RIGHT ? table[position] : IMG_POS_TOP_RIGHT;
}
