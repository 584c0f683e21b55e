#include "PageLayout.h"

#include <algorithm>
#include <cmath>

namespace
{
// A zero bounding-box value gives exactly 0: "-0" must never be printed.
double OriginShift(double boxValue)
{
    return boxValue == 0 ? 0.0 : -boxValue;
}

// Scaling by a side of zero length is undefined; leave that side unscaled
// (the plain quotient would print "inf" or "nan", which no printer reads).
double Ratio(double target, double side)
{
    return side != 0 ? target / side : 1.0;
}
} // namespace

PageLayout ComputePageLayout(const EPStoPSparams_t& params, const double boundingBox[4])
{
    PageLayout layout{};
    double left = std::min(params.imageableLLX, params.imageableURX);
    double right = std::max(params.imageableLLX, params.imageableURX);
    double bottom = std::min(params.imageableLLY, params.imageableURY);
    double top = std::max(params.imageableLLY, params.imageableURY);

    const double w = std::fabs(boundingBox[2] - boundingBox[0]);
    const double h = std::fabs(boundingBox[3] - boundingBox[1]);
    layout.originX = OriginShift(boundingBox[0]);
    layout.originY = OriginShift(boundingBox[1]);

    double areaW, areaH;
    uint32_t position = params.imagePosition;
    bool shrinkToFit = params.shrinkToFit;
    bool fitToPage = params.fitToPage;
    if (params.pageWidth == 0 && params.pageHeight == 0)
    {
        // No page given: the page is the picture itself.
        areaW = w;
        areaH = h;
        left = bottom = 0;
        right = w;
        top = h;
        position = IMG_POS_BOTTOM_LEFT;
        shrinkToFit = fitToPage = false;
    }
    else if (top != 0 || right != 0 || left != 0 || bottom != 0)
    {
        areaW = right - left;
        areaH = top - bottom;
    }
    else
    {
        areaW = params.pageWidth;
        areaH = params.pageHeight;
        left = bottom = 0;
        right = params.pageWidth;
        top = params.pageHeight;
    }

    const double iw = params.imageWidth;
    const double ih = params.imageHeight;
    const bool sizeRequested = !(iw == 0 && ih == 0);
    if (!sizeRequested)
        layout.rotated = (w > h && areaW < areaH) || (w < h && areaW > areaH);
    else
        layout.rotated = (iw < ih && w > h) || (iw > ih && w < h);

    const double ew = layout.rotated ? h : w;
    const double eh = layout.rotated ? w : h;
    const double baseTranslateX = layout.rotated ? h : 0;
    layout.angle = layout.rotated ? 90 : 0;

    double tw = areaW, th = areaH;
    if (!sizeRequested)
    {
        if (shrinkToFit && ew <= areaW && eh <= areaH)
        {
            tw = ew;
            th = eh;
        }
    }
    else
    {
        if (!fitToPage && iw <= areaW && ih <= areaH)
        {
            tw = iw;
            th = ih;
        }
        // A requested size larger than the area overflows it unless asked
        // to shrink.
        if (!shrinkToFit && (ih > th || iw > tw))
        {
            tw = iw;
            th = ih;
        }
    }

    if (params.constrainProportions)
    {
        if (params.widthGiven)
        {
            tw = iw;
            th = eh * Ratio(iw, ew);
        }
        else if (params.heightGiven)
        {
            th = ih;
            tw = ew * Ratio(ih, eh);
        }
    }

    if (params.customSize || params.autoScale)
    {
        // Each axis on its own: another aspect ratio stretches the picture.
        layout.scaleX = Ratio(tw, ew);
        layout.scaleY = Ratio(th, eh);
    }
    else
    {
        layout.scaleX = layout.scaleY = 1;
        tw = ew;
        th = eh;
    }

    // The x factor multiplies the rotated picture's height; exact whenever
    // both factors agree, which is how the host uses it.
    double tx = baseTranslateX * layout.scaleX;
    double ty = 0;
    switch (position)
    {
    case IMG_POS_BOTTOM_LEFT:
        tx += left;
        ty += bottom;
        break;
    case IMG_POS_TOP_LEFT:
        tx += left;
        ty += top - th;
        break;
    case IMG_POS_TOP_RIGHT:
        tx += right - tw;
        ty += top - th;
        break;
    case IMG_POS_BOTTOM_RIGHT:
        tx += right - tw;
        ty += bottom;
        break;
    case IMG_POS_CENTER:
        tx += left + (right - left - tw) * 0.5;
        ty += bottom + (top - bottom - th) * 0.5;
        break;
    default: // other values: no offset into the imageable area
        break;
    }
    layout.translateX = tx;
    layout.translateY = ty;
    layout.left = left;
    layout.bottom = bottom;
    layout.right = right;
    layout.top = top;
    return layout;
}
