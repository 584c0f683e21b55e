#include <gtest/gtest.h>

#include "ServerFixture.h"
#include "db/PluginInitialize.h"

namespace
{
// Runs every query on xml with sentinel outputs; true when all of them
// answered false and left their outputs alone.
bool EveryQueryRefuses(const wxString& xml)
{
    std::vector<stPageAttribute> sheets(1);
    stPageAttribute page;
    page.PaperName = "sentinel";
    stCustomPageSizeAttribute custom;
    custom.LeftHWMargin = 99;
    int dpi = -5;
    wxString unit = "sentinel", osUnit = "sentinel", separator = "sentinel";
    wxString option = "sentinel", value = "sentinel";
    const int required = 0;

    bool any =
        PluginInitialize::InitializeSheetInfo(xml, sheets) ||
        PluginInitialize::InitializeDefaultSheetInfo(xml, page) ||
        PluginInitialize::InitializeCustomPageSizeInfo(xml, custom) ||
        PluginInitialize::InitializeResolution(xml, dpi) ||
        PluginInitialize::InitializePreferenceUnit(xml, unit) ||
        PluginInitialize::InitializeOSUnit(xml, osUnit) ||
        PluginInitialize::InitializeDecimalSeparator(xml, separator) ||
        PluginInitialize::IsServerGA2Enabled(xml) || PluginInitialize::IsServerGA1Enabled(xml) ||
        PluginInitialize::IsServerXRXEnabled(xml) || PluginInitialize::IsServerVDPEnabled(xml) ||
        PluginInitialize::IsServerOneBitTiffEnabled(xml) || PluginInitialize::IsXeroxServer(xml) ||
        PluginInitialize::IsFeatureEnabled(xml, "Resolution") ||
        PluginInitialize::IsRequiredServerVersion(xml, required) ||
        PluginInitialize::InitializeEngineScreenInfo(xml, option, value) ||
        PluginInitialize::InitializeImageCompressionInfo(xml, option, value) ||
        PluginInitialize::InitializeResolutionInfo(xml, option, value);
    const bool untouched = sheets.size() == 1 && page.PaperName == "sentinel" &&
                           custom.LeftHWMargin == 99 && dpi == -5 && unit == "sentinel" &&
                           osUnit == "sentinel" && separator == "sentinel" &&
                           option == "sentinel" && value == "sentinel";
    return !any && untouched;
}
} // namespace

TEST(UnusableDescription, EveryQueryAnswersNo)
{
    EXPECT_TRUE(EveryQueryRefuses(wxString()));
    EXPECT_TRUE(EveryQueryRefuses(ServerFixture("server-malformed.xml")));
    EXPECT_TRUE(EveryQueryRefuses("plain text, not XML"));
}

TEST(SingleValues, FullDescription)
{
    const wxString xml = ServerFixture("server-full.xml");
    int dpi = 0;
    wxString unit, osUnit, separator;
    EXPECT_TRUE(PluginInitialize::InitializeResolution(xml, dpi));
    EXPECT_EQ(1200, dpi);
    EXPECT_TRUE(PluginInitialize::InitializePreferenceUnit(xml, unit));
    EXPECT_EQ("mm", unit);
    EXPECT_TRUE(PluginInitialize::InitializeOSUnit(xml, osUnit));
    EXPECT_EQ("inch", osUnit);
    EXPECT_TRUE(PluginInitialize::InitializeDecimalSeparator(xml, separator));
    EXPECT_EQ(",", separator);
}

TEST(SingleValues, MissingElementIsTrueAndLeavesOutput)
{
    const wxString xml = ServerFixture("server-empty-root.xml");
    int dpi = 300;
    wxString unit = "inch";
    EXPECT_TRUE(PluginInitialize::InitializeResolution(xml, dpi));
    EXPECT_EQ(300, dpi);
    EXPECT_TRUE(PluginInitialize::InitializePreferenceUnit(xml, unit));
    EXPECT_EQ("inch", unit);
    EXPECT_TRUE(PluginInitialize::InitializeOSUnit(xml, unit));
    EXPECT_TRUE(PluginInitialize::InitializeDecimalSeparator(xml, unit));
    EXPECT_EQ("inch", unit);
}

TEST(SingleValues, EmptyElementGivesEmptyText)
{
    const wxString xml = ServerFixture("server-edge.xml");
    int dpi = 300;
    wxString unit = "inch";
    EXPECT_TRUE(PluginInitialize::InitializeResolution(xml, dpi));
    EXPECT_EQ(0, dpi);
    EXPECT_TRUE(PluginInitialize::InitializePreferenceUnit(xml, unit));
    EXPECT_EQ("", unit);
}

TEST(SingleValues, DirectChildWinsOverDeeperEarlierMatch)
{
    const wxString xml = ServerFixture("server-nested.xml");
    int dpi = 0;
    EXPECT_TRUE(PluginInitialize::InitializeResolution(xml, dpi));
    EXPECT_EQ(600, dpi);
    // No direct child: the first subtree in document order answers.
    wxString unit;
    EXPECT_TRUE(PluginInitialize::InitializePreferenceUnit(xml, unit));
    EXPECT_EQ("point", unit);
}

TEST(OptionSearch, FindsPrefixedOptions)
{
    const wxString xml = ServerFixture("server-full.xml");
    wxString option, value;
    EXPECT_TRUE(PluginInitialize::InitializeEngineScreenInfo(xml, option, value));
    EXPECT_EQ("ErrorDiffusion", option);
    EXPECT_EQ("Error Diffusion", value);
    EXPECT_TRUE(PluginInitialize::InitializeImageCompressionInfo(xml, option, value));
    EXPECT_EQ("Quality", option);
    EXPECT_EQ("High Quality", value);
    EXPECT_TRUE(PluginInitialize::InitializeResolutionInfo(xml, option, value));
    EXPECT_EQ("600x600dpi", option);
    EXPECT_EQ("600 x 600 dpi", value);
}

TEST(OptionSearch, OnlyFirstPrefixIsRemovedAndCaseCounts)
{
    const wxString xml = ServerFixture("server-edge.xml");
    wxString option = "unchanged", value = "unchanged";
    // "OrvOrvErrorDiffusion" and "errordiffusion" do not match.
    EXPECT_TRUE(PluginInitialize::InitializeEngineScreenInfo(xml, option, value));
    EXPECT_EQ("unchanged", option);
    EXPECT_EQ("unchanged", value);
    // A name without the prefix is taken as it stands.
    EXPECT_TRUE(PluginInitialize::InitializeImageCompressionInfo(xml, option, value));
    EXPECT_EQ("Quality", option);
    EXPECT_EQ("no prefix", value);
    // No "RvResolution" at all.
    option = value = "unchanged";
    EXPECT_FALSE(PluginInitialize::InitializeResolutionInfo(xml, option, value));
    EXPECT_EQ("unchanged", option);
}
