#include "host/sunpath/DrawingPicture.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

/// A picture of 100 x 80 pixels, two for each of the drawing.
Image picture(DrawnShape shape) {
    const auto letters = Letters::read(programFont());
    EXPECT_TRUE(letters) << letters.message();
    return pictureOf({.width_px = 50, .height_px = 40, .title = "", .shapes = {std::move(shape)}},
                     2, letters.value());
}

int grey(const Image& image, int x, int y) {
    const auto pixel = image.pixel(x, y);
    EXPECT_EQ(pixel[0], pixel[1]);
    EXPECT_EQ(pixel[0], pixel[2]);
    EXPECT_EQ(pixel[3], 255);
    return pixel[0];
}

TEST(DrawingPicture, FillsAreasAsFarAsTheyCoverPixels) {
    const Image image = picture(DrawnPath{
        .lines = {{{10, 10}, {20.25, 10}, {20.25, 20}, {10, 20}}}, .is_closed = true, .fill = 0});
    ASSERT_EQ(image.width, 100);
    ASSERT_EQ(image.height, 80);
    EXPECT_EQ(grey(image, 20, 20), 0);
    EXPECT_EQ(grey(image, 39, 39), 0);
    EXPECT_EQ(grey(image, 19, 20), 255);
    EXPECT_EQ(grey(image, 20, 40), 255);
    EXPECT_NEAR(grey(image, 40, 30), 128, 1); // half of it
}

TEST(DrawingPicture, AreasThatOverlapAreNoHoles) {
    const Image image = picture(DrawnPath{
        .lines = {{{5, 5}, {25, 5}, {25, 25}, {5, 25}}, {{10, 10}, {30, 10}, {30, 30}, {10, 30}}},
        .is_closed = true,
        .fill = 0.5});
    for (const int at : {20, 40, 55})
        EXPECT_EQ(grey(image, at, at), 128);
    EXPECT_EQ(grey(image, 55, 15), 255);
}

TEST(DrawingPicture, StrokesLinesWithTheirDashes) {
    const Image image = picture(DrawnPath{.lines = {{{5, 20}, {45, 20}}},
                                          .stroke = DrawnStroke{.width_px = 2, .dash_px = 5}});
    EXPECT_EQ(grey(image, 15, 38), 0);
    EXPECT_EQ(grey(image, 15, 41), 0);
    EXPECT_EQ(grey(image, 15, 37), 255);
    EXPECT_EQ(grey(image, 15, 42), 255);
    EXPECT_EQ(grey(image, 25, 40), 255); // a gap
    EXPECT_EQ(grey(image, 35, 40), 0);
    EXPECT_EQ(grey(image, 8, 40), 255); // before the line
}

TEST(DrawingPicture, CirclesAreRings) {
    const Image image = picture(
        DrawnCircle{.middle = {25, 20}, .radius_px = 15, .stroke = DrawnStroke{.width_px = 2}});
    EXPECT_EQ(grey(image, 50, 40), 255);
    EXPECT_EQ(grey(image, 79, 40), 0);
    EXPECT_EQ(grey(image, 50, 10), 0);
    EXPECT_EQ(grey(image, 50, 6), 255);
}

/// How much ink there is in columns of a picture.
int inkIn(const Image& image, int from, int to) {
    int ink = 0;
    for (int y = 0; y < image.height; ++y)
        for (int x = from; x < to; ++x)
            ink += 255 - grey(image, x, y);
    return ink;
}

TEST(DrawingPicture, TextsStandAtTheirAnchor) {
    DrawnText text{.place = {25, 25}, .text = "North", .size_px = 8};
    const Image start = picture(text);
    EXPECT_GT(inkIn(start, 50, 100), 5000);
    EXPECT_EQ(inkIn(start, 0, 50), 0);
    text.anchor = TextAnchor::end;
    const Image end = picture(text);
    EXPECT_EQ(inkIn(end, 50, 100), 0);
    text.anchor = TextAnchor::middle;
    text.is_bold = true;
    const Image middle = picture(text);
    EXPECT_GT(inkIn(middle, 0, 100), 1.2 * inkIn(start, 0, 100));
    EXPECT_GT(inkIn(middle, 0, 50), 2000);
    EXPECT_GT(inkIn(middle, 50, 100), 2000);
}

} // namespace
} // namespace quarn
