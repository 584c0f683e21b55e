// Where the picture lands: the cases of tests/data/engine/placement.txt are
// converted and run through Ghostscript's bbox device, which reports the
// marks and the page size.
#include <sstream>
#include <string>

#include <gtest/gtest.h>

#include "EngineTestSupport.h"
#include "GhostscriptOracle.h"

using namespace hf_test;

TEST(ConvertPlacement, GhostscriptSeesThePictureWhereTheTableSays)
{
    if (!testkit::ProgramAvailable("gs"))
        GTEST_SKIP() << "Ghostscript (gs) not installed";
    testkit::ScratchDir scratch("hf-placement");
    for (const auto& c : testkit::Cases("engine/placement.txt", 5, 21))
    {
        SCOPED_TRACE(c[0]);
        double box[4], marks[4];
        std::istringstream(c[2]) >> box[0] >> box[1] >> box[2] >> box[3];
        std::istringstream(c[4]) >> marks[0] >> marks[1] >> marks[2] >> marks[3];
        double pageW = box[2] - box[0], pageH = box[3] - box[1];
        if (c[1] != "none")
            std::istringstream(c[1]) >> pageW >> pageH;
        std::string spd;
        const std::string page = c[1] == "none" ? "" : "page " + c[1] + "; ";
        const EPStoPSparams_t p = Params(page + c[3] + "; spd << /PageSize [" + Num(pageW) + " " +
                                             Num(pageH) + "] >> setpagedevice",
                                         spd);

        const std::string input = scratch.File("box.eps"), output = scratch.File("box.ps");
        testkit::WriteFile(input, FilledBoxEps(box[0], box[1], box[2], box[3]));
        ASSERT_EQ(DetectAndConvert(input, p, output), 1);
        const GhostscriptReport gs = RunGhostscriptBBox(output);
        ASSERT_FALSE(gs.postscriptError) << gs.process.err;
        ASSERT_TRUE(gs.pageSeen && gs.marked) << "showpage never ran or nothing was marked";
        EXPECT_EQ(gs.pages, 1);
        EXPECT_NEAR(gs.pageWidth, pageW, 0.5);
        EXPECT_NEAR(gs.pageHeight, pageH, 0.5);
        EXPECT_NEAR(gs.marks.llx, marks[0], 1.0);
        EXPECT_NEAR(gs.marks.lly, marks[1], 1.0);
        EXPECT_NEAR(gs.marks.urx, marks[2], 1.0);
        EXPECT_NEAR(gs.marks.ury, marks[3], 1.0);
    }
}

TEST(ConvertPlacement, EmbeddedProgramCannotDisturbTheJob)
{
    if (!testkit::ProgramAvailable("gs"))
        GTEST_SKIP() << "Ghostscript (gs) not installed";
    // An EPS that calls showpage, leaves operands and an open dictionary
    // behind: the wrapper must still print exactly one page without error.
    testkit::ScratchDir scratch("hf-placement");
    const std::string input = scratch.File("messy.eps");
    testkit::WriteFile(input, "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 0 0 100 100\n%%EndComments\n"
                              "1 2 3 10 dict begin 5 dict begin\n"
                              "0 0 moveto 100 0 lineto 100 100 lineto closepath fill showpage\n");
    std::string spd;
    ASSERT_EQ(DetectAndConvert(input, Params("", spd), scratch.File("messy.ps")), 1);
    const GhostscriptReport gs = RunGhostscriptBBox(scratch.File("messy.ps"));
    EXPECT_FALSE(gs.postscriptError) << gs.process.err;
    EXPECT_EQ(gs.pages, 1);
}
