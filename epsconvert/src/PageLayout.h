#pragma once
// Where and how the picture goes on the page: the numbers of the wrapper's
// page setup and its DSC boxes.
#include "EPStoPSparams.h"

struct PageLayout
{
    double left, bottom, right, top; // imageable area, the header's boxes
    bool rotated;
    double translateX, translateY; // page setup translate
    double angle;                  // 0 or 90
    double scaleX, scaleY;
    double originX, originY; // moves the bounding box's corner to the origin
};

// boundingBox is llx, lly, urx, ury of the EPS file.
PageLayout ComputePageLayout(const EPStoPSparams_t& params, const double boundingBox[4]);
