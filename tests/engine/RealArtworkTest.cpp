// Real EPS artwork from installed packages, plain and wrapped by epstool in a
// DOS EPS binary with a TIFF preview: it must convert and render cleanly, and
// the wrapped file must give the same page as the plain one.
#include <glob.h>

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "EngineTestSupport.h"
#include "GhostscriptOracle.h"

using namespace hf_test;

namespace
{
// EPS files that Debian packages install: Ghostscript's examples where the
// package ships them, and the artwork that comes with Tk.
std::vector<std::string> InstalledArtwork()
{
    std::vector<std::string> found;
    for (const char* pattern :
         {"/usr/share/ghostscript/*/examples/*.eps", "/usr/share/doc/ghostscript*/examples/*.eps",
          "/usr/share/tcltk/tk*/images/*.eps"})
    {
        glob_t matches;
        if (glob(pattern, 0, nullptr, &matches) == 0)
            for (size_t i = 0; i < matches.gl_pathc; ++i)
                found.push_back(matches.gl_pathv[i]);
        globfree(&matches);
    }
    return found;
}

// Original size, and A4 with the picture fitted into an area 18 points in
// from the edges and centred.
struct Records
{
    std::string spd, none;
    const EPStoPSparams_t a4 = Params("page 595 842; area 18 18 577 824; pos 4; auto; fit; "
                                      "spd << /PageSize [595 842] >> setpagedevice",
                                      spd);
    const EPStoPSparams_t original = Params("", none);
};

std::string BaseName(const std::string& path)
{
    return path.substr(path.rfind('/') + 1);
}
} // namespace

TEST(RealArtwork, ConvertsAndRendersWithoutError)
{
    if (!testkit::ProgramAvailable("gs"))
        GTEST_SKIP() << "Ghostscript (gs) not installed";
    const std::vector<std::string> artwork = InstalledArtwork();
    if (artwork.empty())
        GTEST_SKIP() << "no EPS artwork installed (ghostscript examples or Tk images)";
    testkit::ScratchDir scratch("hf-artwork");
    const Records records;
    for (const std::string& eps : artwork)
    {
        SCOPED_TRACE(eps);
        const std::string before = Fingerprint(eps);
        const std::string original = scratch.File(BaseName(eps) + ".orig.ps");
        const std::string onA4 = scratch.File(BaseName(eps) + ".a4.ps");
        ASSERT_EQ(DetectAndConvert(eps, records.original, original), 1);
        ASSERT_EQ(DetectAndConvert(eps, records.a4, onA4), 1);
        EXPECT_TRUE(Fingerprint(eps) == before);

        // Original size: the page is the picture, the marks lie on it.
        const GhostscriptReport own = RunGhostscriptBBox(original);
        EXPECT_FALSE(own.postscriptError) << own.process.err;
        EXPECT_EQ(own.pages, 1);
        EXPECT_TRUE(own.marked);
        EXPECT_GT(own.marks.urx - own.marks.llx, 1);

        // Fitted to the A4 area: the marks fill it in one direction at least.
        const GhostscriptReport a4 = RunGhostscriptBBox(onA4);
        EXPECT_FALSE(a4.postscriptError) << a4.process.err;
        EXPECT_EQ(a4.pages, 1);
        EXPECT_NEAR(a4.pageWidth, 595, 0.5);
        EXPECT_NEAR(a4.pageHeight, 842, 0.5);
        EXPECT_GE(a4.marks.llx, 17);
        EXPECT_GE(a4.marks.lly, 17);
        EXPECT_LE(a4.marks.urx, 578);
        EXPECT_LE(a4.marks.ury, 825);
        EXPECT_GT(std::max(a4.marks.urx - a4.marks.llx, a4.marks.ury - a4.marks.lly), 500);
    }
}

TEST(RealArtwork, DosBinaryFromEpstoolGivesThePostScriptSectionOnly)
{
    if (!testkit::ProgramAvailable("gs") || !testkit::ProgramAvailable("epstool"))
        GTEST_SKIP() << "needs Ghostscript (gs) and epstool";
    const std::vector<std::string> artwork = InstalledArtwork();
    if (artwork.empty())
        GTEST_SKIP() << "no EPS artwork installed (ghostscript examples or Tk images)";
    testkit::ScratchDir scratch("hf-artwork");
    const Records records;
    for (const std::string& eps : artwork)
    {
        SCOPED_TRACE(eps);
        const std::string wrapped = scratch.File(BaseName(eps) + ".dos.eps");
        const testkit::ProcessResult made = testkit::RunProgram(
            {"epstool", "--add-tiff-preview", "--device", "tiffg3", eps, wrapped});
        ASSERT_EQ(made.exitCode, 0) << made.err;
        const std::string dosBytes = testkit::ReadFile(wrapped);
        ASSERT_GE(dosBytes.size(), 30u);
        ASSERT_EQ(dosBytes.compare(0, 4, "\xC5\xD0\xD3\xC6"), 0) << "epstool made no DOS EPS";

        void* context = nullptr;
        ASSERT_EQ(IsThisEPS(wrapped.c_str(), &context), 1u);
        const EPSinfo_t info = *static_cast<EPSinfo_t*>(context);
        const std::string section =
            dosBytes.substr(static_cast<size_t>(info.psOffset), static_cast<size_t>(info.psLength));
        const std::string fromDos = scratch.File("dos.ps");
        ASSERT_EQ(ConvertEPStoPS(&context, &records.a4, fromDos.c_str()), 1);

        // Exactly the PostScript section between the wrapper's parts.
        const std::string out = testkit::ReadFile(fromDos);
        const size_t begin = out.find("%%BeginDocument:");
        ASSERT_NE(begin, std::string::npos);
        const size_t body = out.find("\r\n", begin) + 2;
        EXPECT_EQ(out.compare(body, section.size(), section), 0);
        EXPECT_EQ(out.compare(body + section.size(), 15, "%%EndDocument\r\n"), 0);
        EXPECT_EQ(out.find("II*"), std::string::npos) << "TIFF preview bytes in the output";
        EXPECT_EQ(out.find("\xC5\xD0\xD3\xC6"), std::string::npos);

        // epstool rewrites the header comments (it rounds the high-resolution
        // box), so the same page comes from its section saved as a plain file.
        const std::string sectionFile = scratch.File("section.eps");
        testkit::WriteFile(sectionFile, section);
        const std::string fromSection = scratch.File("section.ps");
        ASSERT_EQ(DetectAndConvert(sectionFile, records.a4, fromSection), 1);
        const std::string sectionRaster = RenderToPgm(fromSection, 36);
        ASSERT_FALSE(sectionRaster.empty());
        EXPECT_TRUE(sectionRaster == RenderToPgm(fromDos, 36))
            << "the wrapped file renders differently";

        // And the marks match those of the original plain file.
        const std::string fromPlain = scratch.File("plain.ps");
        ASSERT_EQ(DetectAndConvert(eps, records.a4, fromPlain), 1);
        const GhostscriptReport plain = RunGhostscriptBBox(fromPlain);
        const GhostscriptReport dos = RunGhostscriptBBox(fromDos);
        EXPECT_FALSE(dos.postscriptError) << dos.process.err;
        EXPECT_NEAR(dos.marks.llx, plain.marks.llx, 0.5);
        EXPECT_NEAR(dos.marks.lly, plain.marks.lly, 0.5);
        EXPECT_NEAR(dos.marks.urx, plain.marks.urx, 0.5);
        EXPECT_NEAR(dos.marks.ury, plain.marks.ury, 0.5);
    }
}
