#include <gtest/gtest.h>
#include <hotfolder/HFTranslations.h>

#include "ImagePosition.h"

TEST(ImagePositions, TablesBothWays)
{
    const FilterImgPosition_t forward[] = {FILTER_IMG_POS_BOTTOM_LEFT, FILTER_IMG_POS_TOP_LEFT,
                                           FILTER_IMG_POS_TOP_RIGHT, FILTER_IMG_POS_BOTTOM_RIGHT,
                                           FILTER_IMG_POS_CENTER};
    for (uint32_t p = 0; p <= 4; ++p)
    {
        EXPECT_EQ(ConvertToImgPos(static_cast<ImagePosition_t>(p)), forward[p]) << p;
        EXPECT_EQ(ConvertFromImgPos(ConvertToImgPos(static_cast<ImagePosition_t>(p))), p);
    }
    EXPECT_EQ(ConvertToImgPos(static_cast<ImagePosition_t>(7)), FILTER_IMG_POS_TOP_RIGHT);
    EXPECT_EQ(ConvertFromImgPos(FILTER_IMG_POS_TOP_RIGHT), IMG_POS_TOP_RIGHT);
    EXPECT_EQ(ConvertFromImgPos(static_cast<FilterImgPosition_t>(9)), IMG_POS_TOP_RIGHT);
    EXPECT_EQ(ConvertFromImgPos(FILTER_IMG_POS_CENTER), IMG_POS_CENTER);
}

TEST(ImagePositions, DisplayWordsInEveryLanguage)
{
    EXPECT_EQ(ConvertToImgPosStr("Top Left"), IMG_POS_TOP_LEFT);
    EXPECT_EQ(ConvertToImgPosStr("Top Right"), IMG_POS_TOP_RIGHT);
    EXPECT_EQ(ConvertToImgPosStr("Center"), IMG_POS_CENTER);
    EXPECT_EQ(ConvertToImgPosStr("Bottom Right"), IMG_POS_BOTTOM_RIGHT);
    EXPECT_EQ(ConvertToImgPosStr("Bottom Left"), IMG_POS_BOTTOM_LEFT);
    // Exact and case-sensitive; anything else is the centre.
    EXPECT_EQ(ConvertToImgPosStr("top left"), IMG_POS_CENTER);
    EXPECT_EQ(ConvertToImgPosStr(""), IMG_POS_CENTER);
    EXPECT_EQ(ConvertToImgPosStr("Bottom  Left"), IMG_POS_CENTER);
    // Words stored by a German or French panel are found through the catalogues.
    EXPECT_EQ(ConvertToImgPosStr("Unten links"), IMG_POS_BOTTOM_LEFT);
    EXPECT_EQ(ConvertToImgPosStr("Oben rechts"), IMG_POS_TOP_RIGHT);
    EXPECT_EQ(ConvertToImgPosStr(wxString::FromUTF8("En bas à droite")), IMG_POS_BOTTOM_RIGHT);
}
