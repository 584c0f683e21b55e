#include <clocale>
#include <string>

#include <gtest/gtest.h>

#include "SettingsKeys.h"

namespace
{
// Runs the test body under de_DE.UTF-8 and puts the previous locale back.
class DecimalCommaLocale : public ::testing::Test
{
protected:
    void SetUp() override
    {
        m_saved = setlocale(LC_ALL, nullptr);
        if (!setlocale(LC_ALL, "de_DE.UTF-8"))
            GTEST_SKIP() << "de_DE.UTF-8 is not installed (scripts/setup.sh)";
    }
    void TearDown() override { setlocale(LC_ALL, m_saved.c_str()); }

private:
    std::string m_saved;
};
} // namespace

TEST(SettingsFlags, OnlyExactOneIsOn)
{
    EXPECT_TRUE(IsSettingOn("1"));
    EXPECT_FALSE(IsSettingOn("true"));
    EXPECT_FALSE(IsSettingOn("True"));
    EXPECT_FALSE(IsSettingOn(" 1"));
    EXPECT_FALSE(IsSettingOn(""));
    EXPECT_EQ("1", FormatSettingFlag(true));
    EXPECT_EQ("0", FormatSettingFlag(false));
}

TEST(SettingsFlags, EmptyValueTakesDefaultAndReadingInsertsKey)
{
    MapPropToValue settings(100);
    EXPECT_TRUE(
        ReadSettingFlag(settings, SettingsKeys::ORIGINALSIZE, SettingsDefaults::ORIGINALSIZE));
    ASSERT_EQ(1u, settings.count(SettingsKeys::ORIGINALSIZE));
    EXPECT_TRUE(settings[SettingsKeys::ORIGINALSIZE].empty());

    settings[SettingsKeys::ORIGINALSIZE] = "0";
    EXPECT_FALSE(ReadSettingFlag(settings, SettingsKeys::ORIGINALSIZE, true));
    settings[SettingsKeys::FITTOPAGE] = "yes";
    EXPECT_FALSE(ReadSettingFlag(settings, SettingsKeys::FITTOPAGE, SettingsDefaults::FITTOPAGE));
}

TEST(SettingsMeasures, PrintfStyleWithPoint)
{
    EXPECT_EQ("595.500000", FormatSettingDouble(595.5));
    EXPECT_EQ("612.000000", FormatSettingDouble(612));
    EXPECT_EQ("-12.125000", FormatSettingDouble(-12.125));
    EXPECT_EQ("0.000001", FormatSettingDouble(0.0000009));
    EXPECT_EQ("36", FormatSettingInt(36));
    EXPECT_EQ("-7", FormatSettingInt(-7));
}

TEST_F(DecimalCommaLocale, StoredMeasuresKeepPointUnderGerman)
{
    // Proves the locale really is a decimal-comma one.
    ASSERT_STREQ(",", localeconv()->decimal_point);
    EXPECT_EQ("595.500000", FormatSettingDouble(595.5));
    double value = 0;
    EXPECT_TRUE(ParseSettingDouble("842.900000", value));
    EXPECT_DOUBLE_EQ(842.9, value);
    EXPECT_FALSE(ParseSettingDouble("842,9", value));
    EXPECT_DOUBLE_EQ(842.0, value);
}

TEST(SettingsMeasures, ParseReportsIncompleteText)
{
    double value = -1;
    EXPECT_FALSE(ParseSettingDouble("", value));
    EXPECT_EQ(0.0, value);
    EXPECT_FALSE(ParseSettingDouble("abc", value));
    EXPECT_EQ(0.0, value);
    EXPECT_TRUE(ParseSettingDouble(" 6.35 ", value));
    EXPECT_DOUBLE_EQ(6.35, value);
    EXPECT_FALSE(ParseSettingDouble("6.35mm", value));
    EXPECT_DOUBLE_EQ(6.35, value);
}

TEST(SettingsUnit, CustomPageUnitDecoding)
{
    Unit_t unit = UNIT_POINT;
    EXPECT_TRUE(DecodeCustomPageUnit("", unit));
    EXPECT_EQ(UNIT_INCH, unit);
    EXPECT_TRUE(DecodeCustomPageUnit("1", unit));
    EXPECT_EQ(UNIT_MM, unit);
    EXPECT_TRUE(DecodeCustomPageUnit("2", unit));
    EXPECT_EQ(UNIT_POINT, unit);
    EXPECT_FALSE(DecodeCustomPageUnit("7", unit));
    EXPECT_EQ(UNIT_POINT, unit);
    EXPECT_TRUE(DecodeCustomPageUnit("0", unit));
    EXPECT_EQ(UNIT_INCH, unit);
}

TEST(SettingsUnit, OriginalDimensionDefaultsAreTheSameLength)
{
    double inch = 0, mm = 0;
    ASSERT_TRUE(ParseSettingDouble(DefaultOriginalDimension(true), inch));
    ASSERT_TRUE(ParseSettingDouble(DefaultOriginalDimension(false), mm));
    convertToUnit(inch, UNIT_INCH, UNIT_MM);
    EXPECT_DOUBLE_EQ(mm, inch);
}
