#include <gtest/gtest.h>

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
