// A folder's imageable area is the one its printer description gives for
// the folder's paper, and none where that is unknown.
#include <cstdio>
#include <sstream>

#include "PreviewTestSupport.h"
#include "preview/PagePreview.h"

namespace
{
// The description's own "*ImageableArea paper/...: "llx lly urx ury"" line.
bool PpdArea(const std::string& ppdText, const std::string& paper, PointRect& area)
{
    std::istringstream lines(ppdText);
    for (std::string line; std::getline(lines, line);)
        if (line.rfind("*ImageableArea " + paper + "/", 0) == 0 ||
            line.rfind("*ImageableArea " + paper + ":", 0) == 0)
            return std::sscanf(line.c_str() + line.find('"'), "\"%lf %lf %lf %lf", &area.x0,
                               &area.y0, &area.x1, &area.y1) == 4;
    return false;
}

TEST(ImageableArea, IsThePrintersAreaForTheFoldersPaper)
{
    for (const auto& row : testkit::Cases("manager/preview-imageable.txt", 4, 4))
    {
        SCOPED_TRACE(row[3]);
        testkit::ScratchDir scratch("hf-preview-area");
        setenv("HOTFOLDER_WAREHOUSE_ROOT", scratch.Sub("machine").c_str(), 1);
        std::string ppd = row[0];
        if (ppd.rfind("postscript-hp:", 0) == 0)
        {
            const auto got =
                testkit::RunProgram({"/usr/lib/cups/driver/postscript-hp", "cat", ppd});
            ppd = scratch.File("printer.ppd");
            ASSERT_TRUE(got.exitCode == 0 && testkit::WriteFile(ppd, got.out)) << row[0];
        }
        ASSERT_TRUE(ppd == "-" || testkit::Exists(ppd)) << ppd;
        ASSERT_TRUE(preview_test::MakeHotFolder(scratch.File("hot"), ppd, row[1]));

        const PointRect area = ImageableAreaOf(scratch.File("hot"));
        PointRect expected;
        if (row[2] != "none")
        {
            ASSERT_TRUE(PpdArea(testkit::ReadFile(ppd), row[2], expected));
        }
        EXPECT_NEAR(area.x0, expected.x0, 0.01);
        EXPECT_NEAR(area.y0, expected.y0, 0.01);
        EXPECT_NEAR(area.x1, expected.x1, 0.01);
        EXPECT_NEAR(area.y1, expected.y1, 0.01);
    }
}
} // namespace
