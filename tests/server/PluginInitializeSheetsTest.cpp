#include <clocale>
#include <string>

#include <gtest/gtest.h>

#include "ServerFixture.h"
#include "db/PluginInitialize.h"

TEST(SheetInfo, FullDescriptionGivesThreePapersInOrder)
{
    std::vector<stPageAttribute> sheets;
    ASSERT_TRUE(PluginInitialize::InitializeSheetInfo(ServerFixture("server-full.xml"), sheets));
    ASSERT_EQ(3u, sheets.size());
    EXPECT_EQ("Letter", sheets[0].PaperName);
    EXPECT_EQ("Letter (8.5 x 11 in)", sheets[0].PaperDisplayName);
    EXPECT_EQ(612, sheets[0].Width);
    EXPECT_EQ(792, sheets[0].Height);
    EXPECT_EQ(12, sheets[0].Left);
    EXPECT_EQ(12.5, sheets[0].Top);
    EXPECT_EQ(600, sheets[0].Right);
    EXPECT_EQ(779.5, sheets[0].Bottom);
    EXPECT_EQ("<</PageSize [612 792] /ImagingBBox null>> setpagedevice", sheets[0].PSCommand);
    EXPECT_EQ("A4", sheets[1].PaperName);
    EXPECT_DOUBLE_EQ(595.28, sheets[1].Width);
    EXPECT_DOUBLE_EQ(841.89, sheets[1].Height);
    EXPECT_EQ("Tabloid", sheets[2].PaperName);
    EXPECT_EQ("11x17", sheets[2].PaperAlias);
    EXPECT_EQ(0, sheets[2].Reserved1);
}

TEST(SheetInfo, OmittedFieldCarriesThePreviousGroupsValue)
{
    std::vector<stPageAttribute> sheets;
    ASSERT_TRUE(PluginInitialize::InitializeSheetInfo(ServerFixture("server-full.xml"), sheets));
    ASSERT_EQ(3u, sheets.size());
    EXPECT_EQ("LTR", sheets[1].PaperAlias);
}

TEST(SheetInfo, AppendsWithoutClearing)
{
    std::vector<stPageAttribute> sheets(1);
    sheets[0].PaperName = "kept";
    ASSERT_TRUE(PluginInitialize::InitializeSheetInfo(ServerFixture("server-full.xml"), sheets));
    ASSERT_EQ(4u, sheets.size());
    EXPECT_EQ("kept", sheets[0].PaperName);
    EXPECT_EQ("Letter", sheets[1].PaperName);
}

TEST(SheetInfo, EmptyCommandAndTrailingGroupAddNothing)
{
    std::vector<stPageAttribute> sheets;
    ASSERT_TRUE(PluginInitialize::InitializeSheetInfo(ServerFixture("server-edge.xml"), sheets));
    // "First" ends with an empty PSCommand, "Trailing" with none at all; only
    // "Second" closes a group, inheriting First's sizes.
    ASSERT_EQ(1u, sheets.size());
    EXPECT_EQ("Second", sheets[0].PaperName);
    EXPECT_EQ("second", sheets[0].PSCommand);
    EXPECT_EQ(100.5, sheets[0].Width);
    EXPECT_EQ(200.25, sheets[0].Height);
}

TEST(SheetInfo, MissingSheetInfoIsFalse)
{
    std::vector<stPageAttribute> sheets;
    EXPECT_FALSE(PluginInitialize::InitializeSheetInfo(ServerFixture("server-nested.xml"), sheets));
    EXPECT_TRUE(sheets.empty());
}

TEST(SheetInfo, NumbersUsePointUnderDecimalCommaLocale)
{
    const std::string saved = setlocale(LC_ALL, nullptr);
    if (!setlocale(LC_ALL, "de_DE.UTF-8"))
        GTEST_SKIP() << "de_DE.UTF-8 is not installed (scripts/setup.sh)";
    std::vector<stPageAttribute> sheets;
    const bool found =
        PluginInitialize::InitializeSheetInfo(ServerFixture("server-full.xml"), sheets);
    stCustomPageSizeAttribute custom;
    PluginInitialize::InitializeCustomPageSizeInfo(ServerFixture("server-full.xml"), custom);
    setlocale(LC_ALL, saved.c_str());

    ASSERT_TRUE(found);
    ASSERT_EQ(3u, sheets.size());
    EXPECT_DOUBLE_EQ(595.28, sheets[1].Width);
    EXPECT_DOUBLE_EQ(12.5, sheets[0].Top);
    EXPECT_DOUBLE_EQ(283.46, custom.MinMediaWidth);
}

TEST(DefaultSheetInfo, FillsTheRecord)
{
    stPageAttribute page;
    ASSERT_TRUE(
        PluginInitialize::InitializeDefaultSheetInfo(ServerFixture("server-full.xml"), page));
    EXPECT_EQ("A4", page.PaperName);
    EXPECT_EQ("A4", page.PaperAlias);
    EXPECT_DOUBLE_EQ(827.72, page.Bottom);
    EXPECT_EQ("<</PageSize [595 842] /ImagingBBox null>> setpagedevice", page.PSCommand);
}

TEST(DefaultSheetInfo, EmptyElementLeavesRecordAndMissingIsFalse)
{
    stPageAttribute page;
    page.PaperName = "before";
    page.Width = 1;
    EXPECT_TRUE(
        PluginInitialize::InitializeDefaultSheetInfo(ServerFixture("server-edge.xml"), page));
    EXPECT_EQ("before", page.PaperName);
    EXPECT_EQ(1, page.Width);
    EXPECT_FALSE(
        PluginInitialize::InitializeDefaultSheetInfo(ServerFixture("server-nested.xml"), page));
    EXPECT_EQ("before", page.PaperName);
}

TEST(CustomPageSizeInfo, FillsLimitsMarginsCommandAndFlag)
{
    stCustomPageSizeAttribute info;
    ASSERT_TRUE(
        PluginInitialize::InitializeCustomPageSizeInfo(ServerFixture("server-full.xml"), info));
    EXPECT_DOUBLE_EQ(283.46, info.MinMediaWidth);
    EXPECT_DOUBLE_EQ(1332.28, info.MaxMediaWidth);
    EXPECT_DOUBLE_EQ(419.53, info.MinMediaHeight);
    EXPECT_DOUBLE_EQ(1984.25, info.MaxMediaHeight);
    EXPECT_EQ(12, info.LeftHWMargin);
    EXPECT_EQ(13, info.RightHWMargin);
    EXPECT_EQ(14, info.TopHWMargin);
    EXPECT_EQ(15, info.BottomHWMargin);
    EXPECT_EQ(" pop pop pop <</PageSize [5 -2 roll] /ImagingBBox null>> setpagedevice",
              info.command);
    EXPECT_TRUE(info.SubstrateHeightToLength);
}

TEST(CustomPageSizeInfo, EmptyFieldsKeepValuesAndMarginsNarrowTo32Bits)
{
    stCustomPageSizeAttribute info;
    info.MinMediaWidth = 5;
    info.SubstrateHeightToLength = true;
    info.command = "kept";
    ASSERT_TRUE(
        PluginInitialize::InitializeCustomPageSizeInfo(ServerFixture("server-edge.xml"), info));
    EXPECT_EQ(5, info.MinMediaWidth);
    EXPECT_EQ(-7, info.LeftHWMargin);
    EXPECT_EQ(2, info.RightHWMargin); // 2^32 + 2
    EXPECT_FALSE(info.SubstrateHeightToLength);
    EXPECT_EQ("kept", info.command);
}
