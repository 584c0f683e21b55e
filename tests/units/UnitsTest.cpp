#include <gtest/gtest.h>

#include "Units.h"

namespace
{
Unit_t BadUnit(int value)
{
    return static_cast<Unit_t>(value);
}
} // namespace

TEST(ConvertToUnit, SameUnitLeavesValue)
{
    double v = 8.5;
    EXPECT_TRUE(convertToUnit(v, UNIT_INCH, UNIT_INCH));
    EXPECT_EQ(8.5, v);
}

TEST(ConvertToUnit, InvalidSourceFailsTowardsInchAndPointOnly)
{
    double v = 3.0;
    EXPECT_FALSE(convertToUnit(v, BadUnit(5), UNIT_INCH));
    EXPECT_EQ(3.0, v);
    EXPECT_FALSE(convertToUnit(v, BadUnit(5), UNIT_POINT));
    EXPECT_EQ(3.0, v);
    EXPECT_TRUE(convertToUnit(v, BadUnit(5), UNIT_MM));
    EXPECT_EQ(3.0, v);
    // An unknown target does nothing and is not an error.
    EXPECT_TRUE(convertToUnit(v, UNIT_INCH, BadUnit(9)));
    EXPECT_EQ(3.0, v);
}

TEST(ConvertToUnit, PointsToInchAndMillimetre)
{
    double inch = 612;
    EXPECT_TRUE(convertToUnit(inch, UNIT_POINT, UNIT_INCH));
    EXPECT_DOUBLE_EQ(8.5, inch);
    double mm = 612;
    EXPECT_TRUE(convertToUnit(mm, UNIT_POINT, UNIT_MM));
    EXPECT_DOUBLE_EQ(215.9, mm);
}

TEST(ConvertToUnit, MillimetreToPointIsNotRounded)
{
    double v = 210;
    EXPECT_TRUE(convertToUnit(v, UNIT_MM, UNIT_POINT));
    EXPECT_DOUBLE_EQ(595.2755905511812, v);
    double inch = 2;
    EXPECT_TRUE(convertToUnit(inch, UNIT_INCH, UNIT_POINT));
    EXPECT_EQ(144.0, inch);
}

TEST(ConvertToUnit, RoundTripsThroughEveryPair)
{
    const Unit_t units[] = {UNIT_INCH, UNIT_MM, UNIT_POINT};
    for (Unit_t from : units)
        for (Unit_t to : units)
        {
            double v = 123.456;
            convertToUnit(v, from, to);
            convertToUnit(v, to, from);
            EXPECT_NEAR(123.456, v, 1e-9) << from << " -> " << to;
        }
}

TEST(AdjustValue, KeepsValueUnlessThirdDecimalIsSixOrMore)
{
    double keep = 2.2456;
    EXPECT_EQ(2.2456, AdjustValue(keep));
    double drop = 2.2467;
    EXPECT_EQ(2.0, AdjustValue(drop));
    EXPECT_EQ(2.0, drop);
    double eight = 8.506;
    EXPECT_EQ(8.0, AdjustValue(eight));
    double stays = 8.505;
    EXPECT_EQ(8.505, AdjustValue(stays));
}

TEST(AdjustValue, NegativeAndHugeValuesStay)
{
    double negative = -2.2467;
    EXPECT_EQ(-2.2467, AdjustValue(negative));
    double huge = 1e12 + 0.009;
    EXPECT_EQ(1e12 + 0.009, AdjustValue(huge));
}

TEST(GetValueInUnits, FactorTwoPointFiveFourBothWays)
{
    double v = 2.54;
    EXPECT_TRUE(GetValueInUnits(v, UNIT2_CM, UNIT2_INCH));
    EXPECT_DOUBLE_EQ(1.0, v);
    EXPECT_TRUE(GetValueInUnits(v, UNIT2_INCH, UNIT2_CM));
    EXPECT_DOUBLE_EQ(2.54, v);
    EXPECT_TRUE(GetValueInUnits(v, UNIT2_INCH, UNIT2_INCH));
    EXPECT_DOUBLE_EQ(2.54, v);
    EXPECT_FALSE(GetValueInUnits(v, static_cast<Unit2_t>(2), UNIT2_CM));
    EXPECT_DOUBLE_EQ(2.54, v);
}

TEST(FormatUnit, TwoDecimalsAndSuffix)
{
    EXPECT_EQ("8.50in", formatUnit(8.5, UNIT_INCH));
    EXPECT_EQ("215.90mm", formatUnit(215.9, UNIT_MM));
    EXPECT_EQ("612.00pt", formatUnit(612, UNIT_POINT));
    EXPECT_EQ("612.00pt", formatUnit(612, BadUnit(7)));
    EXPECT_EQ("0.01in", formatUnit(0.005000001, UNIT_INCH));
}

TEST(FormatUnit, PointStaysUnderDecimalCommaLocale)
{
    const std::string saved = setlocale(LC_ALL, nullptr);
    if (!setlocale(LC_ALL, "de_DE.UTF-8"))
        GTEST_SKIP() << "de_DE.UTF-8 is not installed (scripts/setup.sh)";
    const wxString text = formatUnit(8.5, UNIT_INCH);
    setlocale(LC_ALL, saved.c_str());
    EXPECT_EQ("8.50in", text);
}

TEST(UnitFromServerWord, KnownWordsElseInch)
{
    EXPECT_EQ(UNIT_INCH, UnitFromServerWord("inch"));
    EXPECT_EQ(UNIT_MM, UnitFromServerWord("mm"));
    EXPECT_EQ(UNIT_POINT, UnitFromServerWord("point"));
    EXPECT_EQ(UNIT_INCH, UnitFromServerWord("MM"));
    EXPECT_EQ(UNIT_INCH, UnitFromServerWord(""));
}
