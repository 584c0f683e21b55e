// Server descriptions made from printer descriptions, read back through the
// filter's own server queries and compared with a separate reading of the
// PPD text.
#include <clocale>
#include <cmath>
#include <cstdio>
#include <locale.h>

#include <gtest/gtest.h>
#include <wx/dir.h>

#include "PpdSources.h"
#include "PpdTextReader.h"
#include "SampleEps.h"
#include "TestKit.h"
#include "ServerFromPpd.h"
#include "cli/Commands.h"
#include "db/PluginInitialize.h"

using printing::ServerDescriptionFromPpd;

namespace
{
std::string Trimmed(const std::string& text)
{
    const size_t first = text.find_first_not_of(" \t\r\n");
    if (first == std::string::npos)
        return std::string();
    return text.substr(first, text.find_last_not_of(" \t\r\n") - first + 1);
}

std::string Utf8(const wxString& text)
{
    return std::string(text.utf8_str());
}

// A standard media name ends in its size: "iso_a4_210x297mm",
// "na_letter_8.5x11in". Width and height in points; false for other names.
bool SizeOfMediaName(const wxString& name, double& width, double& height)
{
    const wxString size = name.AfterLast('_');
    double perUnit = 0;
    if (size.EndsWith("mm"))
        perUnit = 72 / 25.4;
    else if (size.EndsWith("in"))
        perUnit = 72;
    if (perUnit == 0 || !size.BeforeFirst('x').ToCDouble(&width) ||
        !size.AfterFirst('x').Left(size.AfterFirst('x').length() - 2).ToCDouble(&height))
        return false;
    width *= perUnit;
    height *= perUnit;
    return true;
}

// A printer's own page code when it is PostScript; otherwise the standard
// setpagedevice with the paper's size.
void ExpectPageCode(const ppd_text::Description& ppd, const wxString& command,
                    const ppd_text::Paper& paper)
{
    if (ppd_text::IsPostScriptCode(ppd, paper.code))
    {
        EXPECT_EQ(Trimmed(Utf8(command)), Trimmed(paper.code));
        return;
    }
    double width = 0, height = 0;
    ASSERT_EQ(std::sscanf(Utf8(command).c_str(), "<< /PageSize [%lf %lf] >> setpagedevice", &width,
                          &height),
              2)
        << command;
    EXPECT_NEAR(width, paper.width, 1e-3);
    EXPECT_NEAR(height, paper.height, 1e-3);
}

// Everything the description says about papers and custom sizes, checked
// against the PPD text.
void ExpectDescriptionMatches(const std::string& ppdPath)
{
    SCOPED_TRACE(ppdPath);
    wxString xml;
    std::string error;
    ASSERT_TRUE(ServerDescriptionFromPpd(ppdPath, xml, error)) << error;
    ppd_text::Description ppd;
    ASSERT_TRUE(ppd_text::Read(ppdPath, ppd));

    std::vector<ppd_text::Paper> expected;
    for (const auto& paper : ppd.papers)
        if (paper.hasDimension)
            expected.push_back(paper);
    ASSERT_FALSE(expected.empty());

    std::vector<stPageAttribute> sheets;
    ASSERT_TRUE(PluginInitialize::InitializeSheetInfo(xml, sheets));
    ASSERT_EQ(sheets.size(), expected.size());
    for (size_t i = 0; i < sheets.size(); ++i)
    {
        const stPageAttribute& sheet = sheets[i];
        const ppd_text::Paper& paper = expected[i];
        SCOPED_TRACE(paper.keyword);
        EXPECT_EQ(Utf8(sheet.PaperName), paper.keyword);
        EXPECT_EQ(Utf8(sheet.PaperDisplayName), paper.translation);
        EXPECT_NEAR(sheet.Width, paper.width, 1e-3);
        EXPECT_NEAR(sheet.Height, paper.height, 1e-3);
        if (paper.hasArea)
        {
            // The imageable box's corners in the order the panel reads them.
            EXPECT_NEAR(sheet.Left, paper.llx, 1e-3);
            EXPECT_NEAR(sheet.Top, paper.lly, 1e-3);
            EXPECT_NEAR(sheet.Right, paper.urx, 1e-3);
            EXPECT_NEAR(sheet.Bottom, paper.ury, 1e-3);
        }
        ExpectPageCode(ppd, sheet.PSCommand, paper);
        // The standard name given as alias is one of this size.
        double aliasWidth = 0, aliasHeight = 0;
        ASSERT_TRUE(SizeOfMediaName(sheet.PaperAlias, aliasWidth, aliasHeight)) << sheet.PaperAlias;
        EXPECT_NEAR(aliasWidth, paper.width, 2) << sheet.PaperAlias;
        EXPECT_NEAR(aliasHeight, paper.height, 2) << sheet.PaperAlias;
        if (paper.keyword == "A4")
        {
            EXPECT_EQ(sheet.PaperAlias, "iso_a4_210x297mm");
        }
        if (paper.keyword == "Letter")
        {
            EXPECT_EQ(sheet.PaperAlias, "na_letter_8.5x11in");
        }
    }

    stPageAttribute defaultSheet;
    ASSERT_TRUE(PluginInitialize::InitializeDefaultSheetInfo(xml, defaultSheet));
    EXPECT_EQ(Utf8(defaultSheet.PaperName), ppd.defaultPageSize);
    for (const auto& paper : expected)
        if (paper.keyword == ppd.defaultPageSize)
        {
            EXPECT_NEAR(defaultSheet.Width, paper.width, 1e-3);
            EXPECT_NEAR(defaultSheet.Height, paper.height, 1e-3);
            ExpectPageCode(ppd, defaultSheet.PSCommand, paper);
        }

    stCustomPageSizeAttribute custom;
    EXPECT_EQ(PluginInitialize::InitializeCustomPageSizeInfo(xml, custom), ppd.customAllowed);
    if (ppd.customAllowed)
    {
        EXPECT_NEAR(custom.MinMediaWidth, ppd.minWidth, 1e-3);
        EXPECT_NEAR(custom.MaxMediaWidth, ppd.maxWidth, 1e-3);
        EXPECT_NEAR(custom.MinMediaHeight, ppd.minHeight, 1e-3);
        EXPECT_NEAR(custom.MaxMediaHeight, ppd.maxHeight, 1e-3);
        // Whole points, never less than the printer's margin.
        EXPECT_EQ(custom.LeftHWMargin, std::ceil(ppd.margins[0]));
        EXPECT_EQ(custom.BottomHWMargin, std::ceil(ppd.margins[1]));
        EXPECT_EQ(custom.RightHWMargin, std::ceil(ppd.margins[2]));
        EXPECT_EQ(custom.TopHWMargin, std::ceil(ppd.margins[3]));
        EXPECT_EQ(Trimmed(Utf8(custom.command)),
                  ppd_text::IsPostScriptCode(ppd, ppd.customCode)
                      ? Trimmed(ppd.customCode)
                      : "pop pop pop << /PageSize [ 5 -2 roll ] >> setpagedevice");
        // The filter writes the size's operands right in front of the code.
        EXPECT_TRUE(custom.command.StartsWith(" ")) << custom.command;
        EXPECT_FALSE(custom.SubstrateHeightToLength);
    }

    EXPECT_EQ(xml.Find("@PJL"), wxNOT_FOUND);
    EXPECT_EQ(xml.Find("\x1b"), wxNOT_FOUND);
    EXPECT_TRUE(PluginInitialize::IsServerGA2Enabled(xml));
    EXPECT_TRUE(PluginInitialize::IsFeatureEnabled(xml, "HF_EPS_FILTER"));
    // Page sizes go out as job overrides, which the filter skips for
    // servers with substrate families.
    EXPECT_FALSE(PluginInitialize::IsFeatureEnabled(xml, "SubstrateFamilySupported"));
}

// Output of fn on standard output.
template <typename Fn> std::string CaptureStdout(Fn fn)
{
    std::fflush(stdout);
    char name[] = "/tmp/hf-stdout-XXXXXX";
    const int fd = mkstemp(name);
    const int saved = dup(1);
    dup2(fd, 1);
    fn();
    std::fflush(stdout);
    dup2(saved, 1);
    close(saved);
    close(fd);
    const std::string text = testkit::ReadFile(name);
    unlink(name);
    return text;
}
} // namespace

TEST(ServerFromPpd, TestPrinterPapersSizesCommandsAndCustomLimits)
{
    ExpectDescriptionMatches(ppd_sources::TestPpd());

    wxString xml;
    std::string error;
    ASSERT_TRUE(ServerDescriptionFromPpd(ppd_sources::TestPpd(), xml, error));
    std::vector<stPageAttribute> sheets;
    PluginInitialize::InitializeSheetInfo(xml, sheets);
    ASSERT_EQ(sheets.size(), 4u);
    // Latin-1 text, quotes and ampersands come through whole.
    EXPECT_EQ(Utf8(sheets[2].PaperDisplayName), "Carte 10\xC3\x97"
                                                "15 & \"more\"");
    EXPECT_NE(sheets[2].PSCommand.Find("425]\n    /ImagingBBox"), wxNOT_FOUND)
        << "multi-line command kept as written: " << sheets[2].PSCommand;
    EXPECT_EQ(Utf8(sheets[3].PaperDisplayName), "Tab & wide");

    stCustomPageSizeAttribute custom;
    ASSERT_TRUE(PluginInitialize::InitializeCustomPageSizeInfo(xml, custom));
    EXPECT_EQ(custom.LeftHWMargin, 15); // 14.5 rounded away from the edge
    EXPECT_EQ(custom.BottomHWMargin, 18);
    EXPECT_EQ(custom.RightHWMargin, 10);
    EXPECT_EQ(custom.TopHWMargin, 20);
    EXPECT_EQ(custom.MaxMediaHeight, 1296);

    int dpi = 0;
    wxString unit;
    PluginInitialize::InitializeResolution(xml, dpi);
    PluginInitialize::InitializePreferenceUnit(xml, unit);
    EXPECT_EQ(dpi, 1200);
    EXPECT_EQ(unit, "mm") << "the default paper is A4";
}

// One printer description a line: a checked-in one, or a system one that is
// skipped when its package is missing.
TEST(ServerFromPpd, DescriptionsOfTheTable)
{
    size_t checked = 0;
    for (const ppd_sources::TableCase& row : ppd_sources::DescriptionTable())
    {
        if (access(row.path.c_str(), R_OK) != 0)
        {
            std::printf("skipped (not installed): %s\n", row.path.c_str());
            continue;
        }
        SCOPED_TRACE(row.what);
        ExpectDescriptionMatches(row.path);
        ppd_text::Description text;
        ASSERT_TRUE(ppd_text::Read(row.path, text));
        bool kept = false;
        for (const auto& paper : text.papers)
            kept = kept || ppd_text::IsPostScriptCode(text, paper.code);
        EXPECT_EQ(kept, row.keepsCode);
        ++checked;
    }
    EXPECT_GE(checked, 2u);
}

TEST(ServerFromPpd, GenericPostScriptPrinterOfCups)
{
    testkit::ScratchDir dir;
    const std::string ppd = ppd_sources::GenericPostScriptPpd(dir.Path());
    if (ppd.empty())
        GTEST_SKIP() << "ppdc or " << ppd_sources::kSampleDriver
                     << " missing (packages cups-ppdc, cups-common)";
    ExpectDescriptionMatches(ppd);

    wxString xml;
    std::string error;
    ASSERT_TRUE(ServerDescriptionFromPpd(ppd, xml, error));
    wxString unit;
    PluginInitialize::InitializePreferenceUnit(xml, unit);
    EXPECT_EQ(unit, "inch") << "the default paper is Letter";
}

TEST(ServerFromPpd, HpPostScriptPrinters)
{
    testkit::ScratchDir dir;
    const auto ppds = ppd_sources::HpPpds(dir.Path(), 10);
    if (ppds.empty())
        GTEST_SKIP() << ppd_sources::kHpArchive
                     << " missing (package printer-driver-postscript-hp)";
    size_t withCustomSizes = 0;
    for (const std::string& ppd : ppds)
    {
        ExpectDescriptionMatches(ppd);
        ppd_text::Description text;
        ppd_text::Read(ppd, text);
        withCustomSizes += text.customAllowed ? 1 : 0;
    }
    EXPECT_GT(withCustomSizes, 0u) << "the sample should cover custom sizes";
}

TEST(ServerFromPpd, NumbersUseFullStopUnderCommaLocale)
{
    locale_t comma = newlocale(LC_ALL_MASK, "de_DE.UTF-8", nullptr);
    if (!comma)
        comma = newlocale(LC_ALL_MASK, "fr_FR.UTF-8", nullptr);
    if (!comma)
        GTEST_SKIP() << "no locale with a decimal comma installed";
    const locale_t previous = uselocale(comma);
    std::setlocale(LC_NUMERIC, "de_DE.UTF-8");
    wxString xml;
    std::string error;
    const bool made = ServerDescriptionFromPpd(ppd_sources::TestPpd(), xml, error);
    std::setlocale(LC_NUMERIC, "C");
    uselocale(previous);
    freelocale(comma);
    ASSERT_TRUE(made) << error;
    EXPECT_NE(xml.Find("<Width>595.276</Width>"), wxNOT_FOUND);
    EXPECT_NE(xml.Find("<Left>14.17</Left>"), wxNOT_FOUND);
    EXPECT_EQ(xml.Find("595,276"), wxNOT_FOUND);
}

TEST(ServerFromPpd, UnreadableDescriptionsFailAndLeaveTheOutputAlone)
{
    testkit::ScratchDir dir;
    const std::string notPpd = dir.File("letter.ppd");
    testkit::WriteFile(notPpd, "Dear printer,\nthis is not a description.\n");
    const std::string noPageSize = dir.File("nopages.ppd");
    testkit::WriteFile(noPageSize, "*PPD-Adobe: \"4.3\"\n*FormatVersion: \"4.3\"\n"
                                   "*ModelName: \"Blank\"\n*NickName: \"Blank\"\n");
    for (const std::string& path : {dir.File("missing.ppd"), notPpd, noPageSize})
    {
        wxString xml = "untouched";
        std::string error;
        EXPECT_FALSE(ServerDescriptionFromPpd(path, xml, error)) << path;
        EXPECT_EQ(xml, "untouched");
        EXPECT_NE(error.find(path), std::string::npos) << error;
    }
}

TEST(ServerFromPpdCommand, WritesTheFileOrStandardOutput)
{
    testkit::ScratchDir dir;
    wxString expected;
    std::string error;
    ASSERT_TRUE(ServerDescriptionFromPpd(ppd_sources::TestPpd(), expected, error));

    const std::string target = dir.File("server.xml");
    testkit::WriteFile(target, "old");
    EXPECT_EQ(RunServerFromPpdCommand({ppd_sources::TestPpd(), "-o", target}), 0);
    EXPECT_EQ(testkit::ReadFile(target), std::string(expected.utf8_str()));
    wxArrayString left;
    wxDir::GetAllFiles(dir.Path(), &left);
    EXPECT_EQ(left.size(), 1u) << "no temporary file left behind";

    const std::string printed =
        CaptureStdout([] { EXPECT_EQ(RunServerFromPpdCommand({ppd_sources::TestPpd()}), 0); });
    EXPECT_EQ(printed, std::string(expected.utf8_str()));
}

TEST(ServerFromPpdCommand, UsageAndFailures)
{
    const std::string help =
        CaptureStdout([] { EXPECT_EQ(RunServerFromPpdCommand({"--help"}), 0); });
    EXPECT_NE(help.find("server-from-ppd FILE.ppd [-o server.xml]"), std::string::npos);

    EXPECT_EQ(RunServerFromPpdCommand({}), 2);
    EXPECT_EQ(RunServerFromPpdCommand({ppd_sources::TestPpd(), "-o"}), 2);
    EXPECT_EQ(RunServerFromPpdCommand({ppd_sources::TestPpd(), ppd_sources::TestPpd()}), 2);
    EXPECT_EQ(RunServerFromPpdCommand({"--colour", ppd_sources::TestPpd()}), 2);

    // A PPD that cannot be read leaves the old description in place.
    testkit::ScratchDir dir;
    const std::string target = dir.File("server.xml");
    testkit::WriteFile(target, "old");
    EXPECT_EQ(RunServerFromPpdCommand({dir.File("missing.ppd"), "-o", target}), kExitSetupFailed);
    EXPECT_EQ(testkit::ReadFile(target), "old");
    // So does an unwritable target.
    EXPECT_EQ(
        RunServerFromPpdCommand({ppd_sources::TestPpd(), "-o", dir.File("no/such/dir/server.xml")}),
        1);
}
