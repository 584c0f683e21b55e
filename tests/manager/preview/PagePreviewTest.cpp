// Pages previewed as they will print: converted with a scratch folder's
// settings by a trial conversion, rendered, and checked against a direct
// run of Ghostscript's bbox device; and the runs that cannot give a page.
#include <chrono>
#include <cstdlib>

#include "GhostscriptOracle.h"
#include "PreviewTestSupport.h"
#include "SampleEps.h"
#include "preview/PagePreview.h"

namespace
{
// The bounding box of the image's dark pixels, in pixels from the top left.
PointRect DarkPixels(const wxImage& image)
{
    PointRect box{1e9, 1e9, -1, -1};
    for (int y = 0; y < image.GetHeight(); ++y)
        for (int x = 0; x < image.GetWidth(); ++x)
            if (image.GetRed(x, y) + image.GetGreen(x, y) + image.GetBlue(x, y) < 3 * 128)
                box = {std::min(box.x0, 1.0 * x), std::min(box.y0, 1.0 * y),
                       std::max(box.x1, x + 1.0), std::max(box.y1, y + 1.0)};
    return box;
}

double Number(const std::string& text)
{
    return std::strtod(text.c_str(), nullptr);
}

TEST(PagePreview, DrawsWhereTheMarksAre)
{
    for (const auto& row : testkit::Cases("manager/preview-pages.txt", 6, 4))
    {
        SCOPED_TRACE(row[5]);
        testkit::ScratchDir scratch("hf-preview");
        setenv("HOTFOLDER_WAREHOUSE_ROOT", scratch.Sub("machine").c_str(), 1);
        const std::string folder = scratch.File("hot"), eps = scratch.Sub("art") + "/art.eps";
        const std::string out = scratch.Sub("out") + "/trial.ps";
        const auto box = testkit::Split(row[0], " ");
        ASSERT_EQ(box.size(), 4u);
        testkit::WriteFile(eps, sample::RectangleEps(Number(box[0]), Number(box[1]), Number(box[2]),
                                                     Number(box[3])));
        ASSERT_TRUE(preview_test::MakeHotFolder(folder, row[1], row[2]));
        const auto before = preview_test::Listing(scratch.Path() + "/hot");

        wxString error;
        ASSERT_TRUE(ConvertForTrial(folder, eps, HF_MODULE_PATH, out, error)) << error;
        EXPECT_EQ(preview_test::Listing(scratch.Path() + "/hot"), before);
        const auto written = preview_test::Listing(scratch.Path() + "/out");
        ASSERT_EQ(written.size(), 1u) << "only the output, no work files left";

        PreviewOptions options;
        options.longestSide = std::atoi(row[3].c_str());
        const PagePreview preview = RenderPagePreview(out, options);
        ASSERT_TRUE(preview.ok) << preview.reason;
        const hf_test::GhostscriptReport oracle = hf_test::RunGhostscriptBBox(out);
        ASSERT_TRUE(oracle.marked && oracle.pageSeen);
        // A page that sets no size is shown on A4; the bbox device's own is huge.
        const bool sized = row[4] == "job";
        EXPECT_NEAR(preview.pageWidth, sized ? oracle.pageWidth : 595, 0.01);
        EXPECT_NEAR(preview.pageHeight, sized ? oracle.pageHeight : 842, 0.01);
        EXPECT_NEAR(preview.marks.x0, oracle.marks.llx, 0.01);
        EXPECT_NEAR(preview.marks.y0, oracle.marks.lly, 0.01);
        EXPECT_NEAR(preview.marks.x1, oracle.marks.urx, 0.01);
        EXPECT_NEAR(preview.marks.y1, oracle.marks.ury, 0.01);
        EXPECT_NEAR(std::max(preview.image.GetWidth(), preview.image.GetHeight()),
                    options.longestSide, 2);

        const double sx = preview.image.GetWidth() / preview.pageWidth;
        const double sy = preview.image.GetHeight() / preview.pageHeight;
        const PointRect dark = DarkPixels(preview.image);
        EXPECT_NEAR(dark.x0, oracle.marks.llx * sx, 2);
        EXPECT_NEAR(dark.x1, oracle.marks.urx * sx, 2);
        EXPECT_NEAR(dark.y0, (preview.pageHeight - oracle.marks.ury) * sy, 2);
        EXPECT_NEAR(dark.y1, (preview.pageHeight - oracle.marks.lly) * sy, 2);
    }
}

TEST(PagePreview, SaysWhyThereIsNoPage)
{
    for (const auto& row : testkit::Cases("manager/preview-failures.txt", 5, 4))
    {
        SCOPED_TRACE(row[4]);
        testkit::ScratchDir scratch("hf-preview");
        std::string file = scratch.File("page.ps");
        if (row[0] == "(none)")
            file = scratch.File("missing.ps");
        else
        {
            std::string text = row[0];
            for (size_t at; (at = text.find("\\n")) != std::string::npos;)
                text.replace(at, 2, "\n");
            testkit::WriteFile(file, text);
        }
        if (row[1] == "sleeper")
            setenv("HOTFOLDER_GHOSTSCRIPT", preview_test::WriteSleeper(scratch.Path()).c_str(), 1);
        else if (row[1] != "gs")
            setenv("HOTFOLDER_GHOSTSCRIPT", scratch.File(row[1]).c_str(), 1);
        PreviewOptions options;
        options.timeoutSeconds = std::atoi(row[2].c_str());
        const auto started = std::chrono::steady_clock::now();
        const PagePreview preview = RenderPagePreview(file, options);
        const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(
                                 std::chrono::steady_clock::now() - started)
                                 .count();
        unsetenv("HOTFOLDER_GHOSTSCRIPT");
        EXPECT_FALSE(preview.ok);
        EXPECT_FALSE(preview.image.IsOk());
        EXPECT_NE(preview.reason.find(row[3]), wxString::npos) << preview.reason;
        EXPECT_LT(seconds, options.timeoutSeconds + 20) << "returns soon after its time";
    }
}
} // namespace
