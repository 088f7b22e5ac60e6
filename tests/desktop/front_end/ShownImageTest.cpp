#include "desktop/front_end/ShownImage.h"

#include <gtest/gtest.h>

#include <vector>

namespace quarn::desktop {
namespace {

TEST(ShownImage, AnOpaquePictureIsShownAsItIs) {
    const std::vector<std::uint8_t> rgba{10, 20, 30, 255, 40, 50, 60, 255};
    const QImage image = imageOf({2, 1, rgba});
    ASSERT_EQ(image.size(), QSize(2, 1));
    EXPECT_EQ(image.pixel(0, 0), qRgb(10, 20, 30));
    EXPECT_EQ(image.pixel(1, 0), qRgb(40, 50, 60));
}

TEST(ShownImage, BehindWhatIsSeeThroughStandSquares) {
    std::vector<std::uint8_t> rgba(std::size_t{4} * 32 * 32, 0);
    rgba[0] = 200;
    rgba[3] = 255;
    const QImage image = imageOf({32, 32, rgba});
    EXPECT_EQ(image.pixel(0, 0), qRgb(200, 0, 0));
    EXPECT_NE(image.pixel(4, 4), image.pixel(12, 4)) << "squares of 8 pixels";
    EXPECT_EQ(image.pixel(4, 4), image.pixel(12, 12));
    EXPECT_EQ(image.pixel(4, 4), image.pixel(20, 4));
}

TEST(ShownImage, FewerPixelsThanTheSizeSaysAreNoPicture) {
    const std::vector<std::uint8_t> rgba(7, 0);
    EXPECT_TRUE(imageOf({2, 1, rgba}).isNull());
    EXPECT_TRUE(imageOf({}).isNull());
}

} // namespace
} // namespace quarn::desktop
