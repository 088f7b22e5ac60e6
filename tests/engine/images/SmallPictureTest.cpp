#include "engine/images/SmallPicture.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

Image plain(int width_px, int height_px, std::uint8_t level) {
    Image image;
    image.resize(width_px, height_px);
    std::ranges::fill(image.rgba, level);
    return image;
}

TEST(SmallPicture, FitsIntoTheSquareAndKeepsItsAspect) {
    const Image wide = smallPicture(plain(1280, 720, 90), 320);
    EXPECT_EQ(wide.width, 320);
    EXPECT_EQ(wide.height, 180);
    EXPECT_EQ(wide.rgba.size(), std::size_t{4 * 320 * 180});
    const Image tall = smallPicture(plain(100, 4000, 90), 320);
    EXPECT_EQ(tall.width, 8);
    EXPECT_EQ(tall.height, 320);
    const Image line = smallPicture(plain(16384, 1, 90), 320);
    EXPECT_EQ(line.width, 320);
    EXPECT_EQ(line.height, 1);
}

TEST(SmallPicture, OneThatFitsIsCopied) {
    Image image = plain(320, 2, 7);
    image.rgba[5] = 200;
    EXPECT_EQ(smallPicture(image, 320).rgba, image.rgba);
    EXPECT_EQ(smallPicture(Image(), 320).width, 0);
}

TEST(SmallPicture, ShowsEachPlaceWhereItWas) {
    Image image = plain(960, 480, 0);
    for (int y = 0; y < 480; ++y)
        for (int x = 480; x < 960; ++x)
            image.rgba[4 * static_cast<std::size_t>(960 * y + x)] = 240;
    const Image small = smallPicture(image, 320);
    for (int y = 0; y < small.height; ++y)
        for (int x = 0; x < small.width; ++x)
            ASSERT_EQ(small.pixel(x, y)[0], x < 160 ? 0 : 240) << x << ' ' << y;
}

TEST(SmallPicture, APixelIsTheMeanOfWhatItStandsFor) {
    Image image = plain(900, 900, 0);
    for (std::size_t pixel = 0; pixel < image.rgba.size() / 4; pixel += 3)
        image.rgba[4 * pixel] = 90; // each third column
    const Image small = smallPicture(image, 300);
    for (const int x : {0, 150, 299})
        EXPECT_EQ(small.pixel(x, 150)[0], 30);
}

} // namespace
} // namespace quarn
