#pragma once
#include <cstdint>

// Where the scaled picture sits inside the imageable area (converter side).
enum ImagePosition_t : uint32_t
{
    IMG_POS_BOTTOM_LEFT = 0,
    IMG_POS_TOP_LEFT = 1,
    IMG_POS_TOP_RIGHT = 2,
    IMG_POS_BOTTOM_RIGHT = 3,
    IMG_POS_CENTER = 4
};

// The same five places as the filter numbers them.
enum FilterImgPosition_t : uint32_t
{
    FILTER_IMG_POS_CENTER = 0,
    FILTER_IMG_POS_BOTTOM_LEFT = 1,
    FILTER_IMG_POS_TOP_LEFT = 2,
    FILTER_IMG_POS_BOTTOM_RIGHT = 3,
    FILTER_IMG_POS_TOP_RIGHT = 4
};

// Everything the converter needs about the target page and the placement.
// Lengths are PostScript points, origin lower left, y upwards.
struct EPStoPSparams_t
{
    double imageWidth;  // 0 and 0: keep the bounding box size
    double imageHeight;
    double pageWidth;   // 0 and 0: the page is the picture's own size
    double pageHeight;
    char* setPageDeviceString; // copied verbatim into the setup; not owned
    double imageableLLX;       // corners in either order; all 0: whole page
    double imageableLLY;
    double imageableURX;
    double imageableURY;
    uint32_t imagePosition; // an ImagePosition_t; 5 and above: no offset
    bool shrinkToFit;
    bool fitToPage;
    bool scaleToPrintable; // not read by the converter
    bool autoRotate;       // not read by the converter
    bool constrainProportions;
    bool widthGiven;
    bool heightGiven;
    bool customSize;
    bool autoScale;
};
