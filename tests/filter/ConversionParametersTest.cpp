// Settings text to converter parameters, case by case.
#include <clocale>

#include <gtest/gtest.h>
#include <hotfolder/HFTranslations.h>

#include "EPS.h"

namespace
{
struct Loaded
{
    EPS eps{"test"};
    const EPStoPSparams_t& Load(std::initializer_list<std::pair<const char*, const char*>> settings)
    {
        for (const auto& [key, value] : settings)
            eps.GetSettings()[key] = value;
        eps.LoadEPSParams();
        return eps.GetParams();
    }
};
} // namespace

TEST(ConversionParameters, ConstructorDefaults)
{
    EPS eps("x");
    const EPStoPSparams_t& p = eps.GetParams();
    EXPECT_EQ(p.pageWidth, 595.0);
    EXPECT_EQ(p.pageHeight, 843.0);
    EXPECT_EQ(p.imageableLLX, 12.1);
    EXPECT_EQ(p.imageableLLY, 12.0);
    EXPECT_EQ(p.imageableURX, 583.0);
    EXPECT_EQ(p.imageableURY, 830.0);
    EXPECT_EQ(p.imagePosition, 4u);
    EXPECT_EQ(p.setPageDeviceString, nullptr);
    EXPECT_FALSE(p.customSize || p.autoScale || p.fitToPage || p.shrinkToFit || p.autoRotate);
    EXPECT_EQ(eps.GetSettings().size(), 1u);
    EXPECT_EQ(eps.GetSettings()["OUTPUTFILETYPEEPS"], "1");
}

TEST(ConversionParameters, NoModeLeavesSizesAndFollowsThePage)
{
    Loaded l;
    const auto& p = l.Load({});
    EXPECT_FALSE(p.customSize);
    EXPECT_EQ(p.imageWidth, 0);
    EXPECT_EQ(p.imagePosition, 4u);
    // Page and imageable area always follow the settings: absent reads 0.
    EXPECT_EQ(p.pageWidth, 0);
    EXPECT_EQ(p.imageableURY, 0);
    ASSERT_NE(p.setPageDeviceString, nullptr);
    EXPECT_STREQ(p.setPageDeviceString, "");
    // Every key read exists afterwards.
    for (const char* key :
         {"DEFAULTPAGESIZE", "ORIGINALSIZE", "CUSTOMSIZE", "FORCEAUTOSCALE", "PAGESIZE_COMMAND",
          "IMAGEPOSITION", "FORCEPAGESIZEX", "IMAGEEABLESIZEURY", "AUTOROTATE"})
        EXPECT_EQ(l.eps.GetSettings().count(key), 1u) << key;
}

TEST(ConversionParameters, OriginalSizeWinsOverCustom)
{
    Loaded l;
    l.Load({{"CUSTOMSIZE", "1"}, {"ORIGINALWIDTH", "2"}, {"ORIGINALWIDTHUNIT", "inch"}});
    EXPECT_EQ(l.eps.GetParams().imageWidth, 144);
    const auto& p = l.Load({{"ORIGINALSIZE", "1"}});
    EXPECT_FALSE(p.customSize);
    EXPECT_FALSE(p.autoScale);
    EXPECT_EQ(p.imageWidth, 0);
    EXPECT_EQ(p.imageHeight, 0);
}

TEST(ConversionParameters, CustomSizesInEveryUnitWord)
{
    struct Case
    {
        const char* number;
        const char* unit;
        double points;
    } cases[] = {
        {"2", "inch", 144},  {"25.4", "mm", 72},  {"100", "point", 100},
        {"3", "unknown", 3}, {"1", "Zoll", 72},   {"1", "pouce", 72},
        {"1", "Inch", 1},    {"0.5", "inch", 36}, {"not a number", "inch", 0},
    };
    for (const Case& c : cases)
    {
        Loaded l;
        const auto& p = l.Load({{"CUSTOMSIZE", "1"},
                                {"ORIGINALWIDTH", c.number},
                                {"ORIGINALWIDTHUNIT", c.unit},
                                {"ORIGINALHEIGHT", c.number},
                                {"ORIGINALHEIGHTUNIT", c.unit}});
        EXPECT_TRUE(p.customSize && p.autoScale);
        EXPECT_NEAR(p.imageWidth, c.points, 1e-9) << c.number << " " << c.unit;
        EXPECT_NEAR(p.imageHeight, c.points, 1e-9) << c.number << " " << c.unit;
    }
}

TEST(ConversionParameters, SideFlagsStickOnceSet)
{
    Loaded l;
    l.Load({{"CUSTOMSIZE", "1"}, {"ORIGINALWIDTHOPTION", "1"}, {"CONTRAINPROPORTION", "1"}});
    EXPECT_TRUE(l.eps.GetParams().widthGiven);
    EXPECT_TRUE(l.eps.GetParams().constrainProportions);
    const auto& p = l.Load(
        {{"ORIGINALWIDTHOPTION", "0"}, {"ORIGINALHEIGHTOPTION", "1"}, {"CONTRAINPROPORTION", "0"}});
    EXPECT_TRUE(p.widthGiven);
    EXPECT_TRUE(p.heightGiven);
    EXPECT_FALSE(p.constrainProportions);
}

TEST(ConversionParameters, AutoScaleFitOrShrink)
{
    Loaded l;
    const auto& fit = l.Load({{"FORCEAUTOSCALE", "1"}, {"FITTOPAGE", "1"}, {"SCALETOPRINT", "1"}});
    EXPECT_TRUE(fit.customSize && fit.autoScale && fit.fitToPage && fit.scaleToPrintable);
    EXPECT_FALSE(fit.shrinkToFit);
    const auto& shrink = l.Load({{"FITTOPAGE", "0"}, {"SCALETOPRINT", "true"}});
    EXPECT_TRUE(shrink.shrinkToFit);
    EXPECT_FALSE(shrink.fitToPage);
    EXPECT_FALSE(shrink.scaleToPrintable);
}

TEST(ConversionParameters, FlagsAreExactlyOne)
{
    Loaded l;
    EXPECT_FALSE(l.Load({{"AUTOROTATE", "True"}}).autoRotate);
    EXPECT_FALSE(l.Load({{"AUTOROTATE", "true"}}).autoRotate);
    EXPECT_FALSE(l.Load({{"AUTOROTATE", " 1"}}).autoRotate);
    EXPECT_TRUE(l.Load({{"AUTOROTATE", "1"}}).autoRotate);
}

TEST(ConversionParameters, FirstPageCommandStays)
{
    Loaded l;
    l.Load({{"PAGESIZE_COMMAND", "<</PageSize [595 842]>> setpagedevice"}});
    const char* first = l.eps.GetParams().setPageDeviceString;
    ASSERT_NE(first, nullptr);
    EXPECT_STREQ(first, "<</PageSize [595 842]>> setpagedevice");
    l.Load({{"PAGESIZE_COMMAND", "<</PageSize [612 792]>> setpagedevice"}});
    EXPECT_EQ(l.eps.GetParams().setPageDeviceString, first);
    EXPECT_STREQ(l.eps.GetParams().setPageDeviceString, "<</PageSize [595 842]>> setpagedevice");
}

TEST(ConversionParameters, PageAreaAndPositionFollowEveryLoad)
{
    Loaded l;
    const auto& p = l.Load({{"FORCEPAGESIZEX", "612.000000"},
                            {"FORCEPAGESIZEY", "792.5"},
                            {"IMAGEEABLESIZELLX", "18"},
                            {"IMAGEEABLESIZELLY", "-3.25"},
                            {"IMAGEEABLESIZEURX", "594"},
                            {"IMAGEEABLESIZEURY", "774"},
                            {"IMAGEPOSITION", "Bottom Right"}});
    EXPECT_EQ(p.pageWidth, 612);
    EXPECT_EQ(p.pageHeight, 792.5);
    EXPECT_EQ(p.imageableLLY, -3.25);
    EXPECT_EQ(p.imageableURX, 594);
    EXPECT_EQ(p.imagePosition, 3u);
    EXPECT_EQ(l.Load({{"IMAGEPOSITION", "Oben links"}}).imagePosition, 1u);
    EXPECT_EQ(l.Load({{"IMAGEPOSITION", "bottom right"}}).imagePosition, 4u);
}

TEST(ConversionParameters, DecimalCommaLocaleStillReadsStoredNumbers)
{
    const std::string saved = std::setlocale(LC_ALL, nullptr);
    if (!std::setlocale(LC_ALL, "de_DE.UTF-8"))
        GTEST_SKIP() << "de_DE.UTF-8 is not generated";
    Loaded l;
    const auto& p = l.Load({{"FORCEPAGESIZEX", "595.500000"},
                            {"FORCEPAGESIZEY", "842,25"},
                            {"CUSTOMSIZE", "1"},
                            {"ORIGINALWIDTH", "25.4"},
                            {"ORIGINALWIDTHUNIT", "mm"}});
    const double width = p.pageWidth, height = p.pageHeight, image = p.imageWidth;
    std::setlocale(LC_ALL, saved.c_str());
    EXPECT_EQ(width, 595.5);
    EXPECT_EQ(height, 842.25);
    EXPECT_NEAR(image, 72, 1e-9);
}
