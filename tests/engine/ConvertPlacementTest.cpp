// Where the picture lands: a grid of conversion records is run through
// Ghostscript's bbox device, and the marks and the page size it reports are
// compared with the placement rules, worked out here on their own.
#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "EngineTestSupport.h"
#include "GhostscriptOracle.h"

using namespace hf_test;

namespace
{
struct Picture
{
    const char* name;
    double llx, lly, urx, ury;
};

struct Page
{
    const char* name;
    double width, height;
};

enum class Area
{
    WholePage,
    Given,
    Reversed
};

enum class Sizing
{
    Original,
    Custom,
    ConstrainedWidth,
    ConstrainedHeight,
    FitToPage,
    ShrinkToFit
};

struct Case
{
    Picture picture;
    Page page;
    Area area;
    Sizing sizing;
    uint32_t position;
};

std::string Describe(const Case& c)
{
    static const char* areas[] = {"whole page", "area given", "area reversed"};
    static const char* sizings[] = {"original",           "custom",      "constrained width",
                                    "constrained height", "fit to page", "shrink to fit"};
    return std::string(c.picture.name) + " on " + c.page.name + ", " +
           areas[static_cast<int>(c.area)] + ", " + sizings[static_cast<int>(c.sizing)] +
           ", position " + std::to_string(c.position);
}

EPStoPSparams_t RecordFor(const Case& c)
{
    EPStoPSparams_t p = NoParams();
    p.pageWidth = c.page.width;
    p.pageHeight = c.page.height;
    p.imagePosition = c.position;
    if (c.area != Area::WholePage)
    {
        // Half an inch in from every edge.
        p.imageableLLX = 36;
        p.imageableLLY = 36;
        p.imageableURX = c.page.width - 36;
        p.imageableURY = c.page.height - 36;
        if (c.area == Area::Reversed)
        {
            std::swap(p.imageableLLX, p.imageableURX);
            std::swap(p.imageableLLY, p.imageableURY);
        }
    }
    switch (c.sizing)
    {
    case Sizing::Original:
        break;
    case Sizing::Custom:
        p.customSize = p.autoScale = true;
        p.imageWidth = 250;
        p.imageHeight = 180;
        break;
    case Sizing::ConstrainedWidth:
        p.customSize = p.autoScale = p.constrainProportions = p.widthGiven = true;
        p.imageWidth = 250;
        p.imageHeight = 180;
        break;
    case Sizing::ConstrainedHeight:
        p.customSize = p.autoScale = p.constrainProportions = p.heightGiven = true;
        p.imageWidth = 170;
        p.imageHeight = 260;
        break;
    case Sizing::FitToPage:
        p.customSize = p.autoScale = p.fitToPage = true;
        break;
    case Sizing::ShrinkToFit:
        p.customSize = p.autoScale = p.shrinkToFit = true;
        break;
    }
    return p;
}

struct Rect
{
    double x0, y0, x1, y1;
};

// The placement rules as the host describes them to its users: choose the
// area, turn the picture when its orientation disagrees, size it, put it at
// the chosen corner, then map the picture's corners through the resulting
// page transformation.
Rect ExpectedMarks(const Case& c, const EPStoPSparams_t& p)
{
    const double pw = c.picture.urx - c.picture.llx;
    const double ph = c.picture.ury - c.picture.lly;
    const bool noPage = p.pageWidth == 0 && p.pageHeight == 0;
    const bool areaGiven = c.area != Area::WholePage;

    Rect area{0, 0, p.pageWidth, p.pageHeight};
    if (noPage)
        area = Rect{0, 0, pw, ph};
    else if (areaGiven)
        area = Rect{36, 36, p.pageWidth - 36, p.pageHeight - 36};
    const double areaW = area.x1 - area.x0;
    const double areaH = area.y1 - area.y0;
    const uint32_t position = noPage ? 0 : p.imagePosition;
    const bool fit = !noPage && p.fitToPage;
    const bool shrink = !noPage && p.shrinkToFit;

    const bool requested = p.imageWidth != 0 || p.imageHeight != 0;
    const bool pictureWide = pw > ph, pictureTall = pw < ph;
    bool turn;
    if (requested)
        turn = (p.imageWidth > p.imageHeight && pictureTall) ||
               (p.imageWidth < p.imageHeight && pictureWide);
    else
        turn = (pictureWide && areaW < areaH) || (pictureTall && areaW > areaH);
    // Sides of the picture as it will stand on the page.
    const double sideX = turn ? ph : pw;
    const double sideY = turn ? pw : ph;

    double wantX = areaW, wantY = areaH;
    if (!requested)
    {
        if (shrink && sideX <= areaW && sideY <= areaH)
            wantX = sideX, wantY = sideY;
    }
    else
    {
        const bool fitsArea = p.imageWidth <= areaW && p.imageHeight <= areaH;
        if (!fit && fitsArea)
            wantX = p.imageWidth, wantY = p.imageHeight;
        if (!shrink && (p.imageWidth > wantX || p.imageHeight > wantY))
            wantX = p.imageWidth, wantY = p.imageHeight;
    }
    if (p.constrainProportions && p.widthGiven)
        wantX = p.imageWidth, wantY = sideY * p.imageWidth / sideX;
    else if (p.constrainProportions && p.heightGiven)
        wantY = p.imageHeight, wantX = sideX * p.imageHeight / sideY;

    double fx = 1, fy = 1; // factors along the standing picture's sides
    if (p.customSize || p.autoScale)
        fx = wantX / sideX, fy = wantY / sideY;
    else
        wantX = sideX, wantY = sideY;

    double dx = 0, dy = 0;
    switch (position)
    {
    case 0:
        dx = area.x0, dy = area.y0;
        break;
    case 1:
        dx = area.x0, dy = area.y1 - wantY;
        break;
    case 2:
        dx = area.x1 - wantX, dy = area.y1 - wantY;
        break;
    case 3:
        dx = area.x1 - wantX, dy = area.y0;
        break;
    case 4:
        dx = (area.x0 + area.x1 - wantX) / 2, dy = (area.y0 + area.y1 - wantY) / 2;
        break;
    default:
        break;
    }

    // Page transformation: translate, rotate, scale (fx on the picture's own
    // x axis), then the picture's lower-left corner to the origin. A turned
    // picture is pushed right by its own scaled height.
    const double tx = dx + (turn ? ph * fx : 0);
    const double ty = dy;
    Rect marks{1e300, 1e300, -1e300, -1e300};
    for (double x : {c.picture.llx, c.picture.urx})
        for (double y : {c.picture.lly, c.picture.ury})
        {
            const double u = (x - c.picture.llx) * fx;
            const double v = (y - c.picture.lly) * fy;
            const double px = turn ? tx - v : tx + u;
            const double py = turn ? ty + u : ty + v;
            marks = Rect{std::min(marks.x0, px), std::min(marks.y0, py), std::max(marks.x1, px),
                         std::max(marks.y1, py)};
        }
    return marks;
}

const Picture kPictures[] = {
    {"wide picture", 10, 20, 310, 170},
    {"tall picture", -50, -30, 70, 310},
    {"square picture", 0, 0, 200, 200},
    {"picture left of and below the origin", -200, -100, -100, -50},
};
const Page kPages[] = {
    {"portrait page", 612, 792},
    {"landscape page", 842, 595},
    {"no page", 0, 0},
};

std::vector<Case> Grid()
{
    std::vector<Case> cases;
    const uint32_t positions[] = {0, 1, 2, 3, 4, 9};
    int n = 0;
    for (const Picture& picture : kPictures)
        for (const Page& page : kPages)
            for (Area area : {Area::WholePage, Area::Given, Area::Reversed})
                for (Sizing sizing :
                     {Sizing::Original, Sizing::Custom, Sizing::ConstrainedWidth,
                      Sizing::ConstrainedHeight, Sizing::FitToPage, Sizing::ShrinkToFit})
                    cases.push_back({picture, page, area, sizing, positions[n++ % 6]});
    return cases;
}
} // namespace

TEST(ConvertPlacement, GhostscriptSeesThePictureWhereTheRulesPutIt)
{
    if (!testkit::ProgramAvailable("gs"))
        GTEST_SKIP() << "Ghostscript (gs) not installed";
    ScratchDir scratch;
    for (const Case& c : Grid())
    {
        SCOPED_TRACE(Describe(c));
        EPStoPSparams_t p = RecordFor(c);
        const double pageW = c.page.width ? c.page.width : c.picture.urx - c.picture.llx;
        const double pageH = c.page.height ? c.page.height : c.picture.ury - c.picture.lly;
        char setPageDevice[128];
        std::snprintf(setPageDevice, sizeof setPageDevice, "<< /PageSize [%d %d] >> setpagedevice",
                      static_cast<int>(pageW), static_cast<int>(pageH));
        p.setPageDeviceString = setPageDevice;

        const std::string input = scratch.File("box.eps");
        const std::string output = scratch.File("box.ps");
        WriteBytes(input, FilledBoxEps(c.picture.llx, c.picture.lly, c.picture.urx, c.picture.ury));
        ASSERT_EQ(DetectAndConvert(input, p, output), 1);

        const GhostscriptReport gs = RunGhostscriptBBox(output);
        ASSERT_FALSE(gs.postscriptError) << gs.process.err;
        ASSERT_TRUE(gs.pageSeen) << "showpage never ran";
        EXPECT_EQ(gs.pages, 1);
        EXPECT_NEAR(gs.pageWidth, pageW, 0.5);
        EXPECT_NEAR(gs.pageHeight, pageH, 0.5);

        // The bbox device only sees what lies on the page.
        Rect expected = ExpectedMarks(c, p);
        expected = Rect{std::max(expected.x0, 0.0), std::max(expected.y0, 0.0),
                        std::min(expected.x1, pageW), std::min(expected.y1, pageH)};
        ASSERT_TRUE(gs.marked);
        if (expected.x0 >= expected.x1 || expected.y0 >= expected.y1)
        {
            EXPECT_NEAR(gs.marks.urx - gs.marks.llx, 0, 1) << "marks seen off the page";
            continue;
        }
        EXPECT_NEAR(gs.marks.llx, expected.x0, 1.0);
        EXPECT_NEAR(gs.marks.lly, expected.y0, 1.0);
        EXPECT_NEAR(gs.marks.urx, expected.x1, 1.0);
        EXPECT_NEAR(gs.marks.ury, expected.y1, 1.0);
    }
}

TEST(ConvertPlacement, EmbeddedProgramCannotDisturbTheJob)
{
    if (!testkit::ProgramAvailable("gs"))
        GTEST_SKIP() << "Ghostscript (gs) not installed";
    // An EPS that calls showpage, leaves operands and an open dictionary
    // behind: the wrapper must still print exactly one page without error.
    ScratchDir scratch;
    const std::string input = scratch.File("messy.eps");
    WriteBytes(input, "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 0 0 100 100\n%%EndComments\n"
                      "1 2 3 10 dict begin 5 dict begin\n"
                      "0 0 moveto 100 0 lineto 100 100 lineto closepath fill showpage\n");
    EPStoPSparams_t p = NoParams();
    ASSERT_EQ(DetectAndConvert(input, p, scratch.File("messy.ps")), 1);
    const GhostscriptReport gs = RunGhostscriptBBox(scratch.File("messy.ps"));
    EXPECT_FALSE(gs.postscriptError) << gs.process.err;
    EXPECT_EQ(gs.pages, 1);
}
