#include "engine/images/Opacity.h"

#include <gtest/gtest.h>

namespace quarn::test {
namespace {

Image pixels(std::vector<std::uint8_t> rgba) {
    Image image;
    image.width = static_cast<int>(rgba.size() / 4);
    image.height = 1;
    image.rgba = std::move(rgba);
    return image;
}

TEST(Opacity, OnePixelThatIsNotOpaqueMakesAPictureSeeThrough) {
    EXPECT_FALSE(isSeeThrough(pixels({1, 2, 3, 255, 4, 5, 6, 255})));
    EXPECT_TRUE(isSeeThrough(pixels({1, 2, 3, 255, 4, 5, 6, 254})));
    EXPECT_FALSE(isSeeThrough(Image()));
}

TEST(Opacity, OnWhiteColoursAreMixedByTheirOpacity) {
    Image space;
    const Image picture = pixels({10, 20, 30, 255, 0, 100, 200, 51, 9, 9, 9, 0});
    const ImageView seen = onWhite(picture, space);
    // 51 is a fifth of 255: (0 + 4 * 255) / 5, (100 + 4 * 255) / 5, (200 + 4 * 255) / 5.
    const std::vector<std::uint8_t> expected{10,  20,  30,  255, 204, 224,
                                             244, 255, 255, 255, 255, 255};
    EXPECT_EQ(std::vector<std::uint8_t>(seen.rgba.begin(), seen.rgba.end()), expected);
    EXPECT_EQ(seen.width, 3);
}

TEST(Opacity, AnOpaquePictureIsNotCopied) {
    Image space;
    const Image picture = pixels({10, 20, 30, 255});
    EXPECT_EQ(onWhite(picture, space).rgba.data(), picture.rgba.data());
    EXPECT_TRUE(space.rgba.empty());
}

} // namespace
} // namespace quarn::test
