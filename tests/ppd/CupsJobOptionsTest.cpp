// Job overrides as CUPS options.
#include <gtest/gtest.h>

#include "CupsJobOptions.h"

using printing::CupsOptionsFromOverrides;
using printing::OptionList;

TEST(CupsJobOptions, PaperKeywordBecomesPageSize)
{
    EXPECT_EQ(CupsOptionsFromOverrides({{"PageSize", "A4"}}), (OptionList{{"PageSize", "A4"}}));
    // The filter stores what the settings hold, blanks included.
    EXPECT_EQ(CupsOptionsFromOverrides({{"PageSize", "Letter \t"}}),
              (OptionList{{"PageSize", "Letter"}}));
}

TEST(CupsJobOptions, CustomSizeBecomesCustomKeywordInPoints)
{
    EXPECT_EQ(CupsOptionsFromOverrides({{"PageSize", "Custom"}, {"CustomPageSize", "612 792"}}),
              (OptionList{{"PageSize", "Custom.612x792"}}));
    // Settings keep six decimals; fractions survive, trailing zeros go.
    EXPECT_EQ(CupsOptionsFromOverrides(
                  {{"CustomPageSize", "283.500000 425.250000"}, {"PageSize", "Custom"}}),
              (OptionList{{"PageSize", "Custom.283.5x425.25"}}));
}

TEST(CupsJobOptions, BadCustomSizesLeaveThePaperToTheQueue)
{
    for (const char* size : {"", "612", "612 792 10", "612,5 792", "wide tall", "0 792", "-5 5"})
    {
        EXPECT_TRUE(
            CupsOptionsFromOverrides({{"PageSize", "Custom"}, {"CustomPageSize", size}}).empty())
            << size;
    }
    // A custom size alone does not choose the custom paper.
    EXPECT_TRUE(CupsOptionsFromOverrides({{"CustomPageSize", "612 792"}}).empty());
}

TEST(CupsJobOptions, OtherOverridesPassThroughLastOneWins)
{
    const OptionList options = CupsOptionsFromOverrides({{"Duplex", "None"},
                                                         {"Collate", ""},
                                                         {"PageSize", "A3"},
                                                         {"Duplex", "DuplexNoTumble"},
                                                         {"", "orphan"}});
    EXPECT_EQ(options, (OptionList{{"PageSize", "A3"}, {"Duplex", "DuplexNoTumble"}}));
}
