#include "engine/display/LineBlend.h"
#include "tests/engine/display/LitScenes.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

constexpr int SIZE = 64;

SceneContent before(BackgroundKind kind, KM_Color color = {255, 255, 255, 255}) {
    SceneContent content = cubeOnGround({200, 40, 40, 255});
    content.light.background = kind;
    content.light.background_color = color;
    return content;
}

int alphaAt(const Image& image, int x, int y) {
    return image.pixel(x, y)[3];
}

TEST(Background, EveryColourIsSeenExactlyWhereNothingStands) {
    SceneContent content = before(BackgroundKind::color);
    content.light.has_ground = false;
    for (int value = 0; value < 256; ++value) {
        const auto byte = static_cast<std::uint8_t>(value);
        content.light.background_color = {byte, static_cast<std::uint8_t>(255 - value), 128, 255};
        const Image image = litPicture(content, productView(), 8, 8);
        const auto pixel = image.pixel(0, 0);
        ASSERT_EQ(pixel[0], value);
        ASSERT_EQ(pixel[1], 255 - value);
        ASSERT_EQ(pixel[2], 128);
        ASSERT_EQ(pixel[3], 255);
    }
}

TEST(Background, TheGroundIsOfTheColourToTheBordersAndTakesShadows) {
    for (const KM_Color color : {KM_Color{255, 255, 255, 255}, KM_Color{30, 90, 200, 255}}) {
        const Image image =
            litPicture(before(BackgroundKind::color, color), topView(0.8), SIZE, SIZE);
        for (int i = 0; i < SIZE; ++i) {
            ASSERT_EQ(image.pixel(i, 0)[2], color.b) << i;
            ASSERT_EQ(image.pixel(0, i)[0], color.r) << i;
        }
        const auto shade = image.pixel(SIZE / 2 + 5, SIZE / 2);
        EXPECT_LT(shade[2], color.b - 20);
        // Of the colour's own hue.
        EXPECT_NEAR(shade[0] * color.b, shade[2] * color.r, 20 * 255);
    }
}

TEST(Background, ASunCastsItsShadowOnPlainWhite) {
    SceneContent content = before(BackgroundKind::color);
    content.lights.push_back(sunLight({1, 0, -1}));
    const Image image = litPicture(content, topView(0.5), SIZE, SIZE);
    const int side = SIZE / 2 + SIZE / 5;
    EXPECT_LT(brightness(image, side, SIZE / 2), 200.0);
    EXPECT_GT(brightness(image, SIZE - side, SIZE / 2), 240.0);
}

TEST(Background, TheLightOnAModelIsThatBeforeAnyOther) {
    const Image automatic = litPicture(before(BackgroundKind::automatic), topView(0.5), SIZE, SIZE);
    for (const BackgroundKind kind : {BackgroundKind::color, BackgroundKind::transparent}) {
        const Image image = litPicture(before(kind, {0, 0, 90, 255}), topView(0.5), SIZE, SIZE);
        EXPECT_TRUE(samePixel(image, SIZE / 2, SIZE / 2, automatic, SIZE / 2, SIZE / 2));
    }
}

TEST(Background, ATransparentOneLeavesNothingWhereNothingStandsAndAllOfTheModel) {
    SceneContent content = before(BackgroundKind::transparent);
    content.light.has_ground = false;
    const Image image = litPicture(content, topView(0.5), SIZE, SIZE, 2);
    // The box ends between two pixels 6.4 from the middle.
    for (int x = 0; x < SIZE; ++x) {
        const bool is_inside = std::abs(x - SIZE / 2 + 0.5) < 6.0;
        const bool is_outside = std::abs(x - SIZE / 2 + 0.5) > 7.0;
        if (is_inside) {
            EXPECT_EQ(alphaAt(image, x, SIZE / 2), 255) << x;
        }
        if (is_outside) {
            EXPECT_EQ(alphaAt(image, x, SIZE / 2), 0) << x;
            EXPECT_EQ(brightness(image, x, SIZE / 2), 0.0) << x;
        }
    }
}

TEST(Background, EdgesBeforeNothingAreAsOpaqueAsTheyAreCoveredAndOfTheModelsColour) {
    SceneContent content = before(BackgroundKind::transparent);
    content.light.has_ground = false;
    const Image image = litPicture(content, topView(0.5), SIZE, SIZE, 2);
    // 0.4 of the pixel, by nine rays; the box's colour without a dark or a light fringe.
    const int x = SIZE / 2 + 6;
    EXPECT_NEAR(alphaAt(image, x, SIZE / 2), 0.4 * 255, 30);
    for (std::size_t c = 0; c < 3; ++c)
        EXPECT_NEAR(image.pixel(x, SIZE / 2)[c], image.pixel(SIZE / 2, SIZE / 2)[c], 2) << c;
}

TEST(Background, ShadowsBeforeNothingAreBlackAndAsDarkOverWhiteAsOnIt) {
    const Image clear = litPicture(before(BackgroundKind::transparent), topView(0.5), SIZE, SIZE);
    const Image white = litPicture(before(BackgroundKind::color), topView(0.5), SIZE, SIZE);
    int shaded = 0;
    for (int x = SIZE / 2 + 8; x < SIZE; ++x) {
        const auto pixel = clear.pixel(x, SIZE / 2);
        EXPECT_EQ(pixel[0] + pixel[1] + pixel[2], 0);
        // Laid over white, by the numbers of the pixels, it is the shadow on white.
        EXPECT_NEAR(255 - pixel[3], white.pixel(x, SIZE / 2)[1], 1) << x;
        shaded += pixel[3] > 25 ? 1 : 0;
    }
    EXPECT_GT(shaded, 3);
    EXPECT_EQ(alphaAt(clear, 0, 0), 0);
}

TEST(Background, GlassBeforeNothingLetsItThrough) {
    SceneContent content;
    content.light.background = BackgroundKind::transparent;
    content.light.has_ground = false;
    const std::size_t pane = addMesh(content, floorMesh(-0.2F, -0.2F, 0.2F, 0.2F, 0.0F));
    auto material = std::make_shared<Material>();
    material->base_color = {40, 120, 40, 64};
    material->see_through = true;
    content.meshes[pane].placed.material = material;
    const Image image = litPicture(content, topView(0.5), SIZE, SIZE);
    EXPECT_EQ(alphaAt(image, SIZE / 2, SIZE / 2), 64);
    EXPECT_GT(image.pixel(SIZE / 2, SIZE / 2)[1], image.pixel(SIZE / 2, SIZE / 2)[0] + 40);
}

TEST(Background, WithoutGroundThereIsNoneUnderTheSkyEither) {
    SceneContent content = cubeOnGround();
    content.light.surroundings = Surroundings::sky;
    const KM_Viewport down = perspectiveView({0.5, -0.6, 1.5}, {0, 0, 0});
    const Image with = litPicture(content, down, SIZE, SIZE);
    content.light.has_ground = false;
    const Image without = litPicture(content, down, SIZE, SIZE);
    EXPECT_FALSE(samePixel(with, 4, SIZE - 4, without, 4, SIZE - 4));
    EXPECT_FALSE(frameOf(content, down).frame.has_ground);
}

TEST(Background, EveryDisplayModeStandsBeforeTheColourOrNothing) {
    SceneContent content = before(BackgroundKind::color, {12, 200, 99, 255});
    content.light.has_ground = false;
    for (const DisplayModeAttributes& mode : standardDisplayModes()) {
        content.light.background = BackgroundKind::color;
        const Image colored = drawn(content, productView(), mode, SIZE, SIZE);
        EXPECT_EQ(colored.pixel(0, 0)[1], 200) << mode.english_name.size();
        content.light.background = BackgroundKind::transparent;
        const Image clear = drawn(content, productView(), mode, SIZE, SIZE);
        EXPECT_EQ(alphaAt(clear, 0, 0), 0);
        int most = 0;
        for (int y = 0; y < SIZE; ++y)
            for (int x = 0; x < SIZE; ++x)
                most = std::max(most, alphaAt(clear, x, y));
        EXPECT_GT(most, 100);
    }
}

TEST(Background, LinesBeforeNothingAreAsOpaqueAsTheyAreThick) {
    EXPECT_EQ(blendedOver(0, {10, 20, 30, 255}, 0.5F), 0x80000000U | 10U | 20U << 8 | 30U << 16);
    EXPECT_EQ(blendedOver(0, {10, 20, 30, 255}, 0.0F), 0U);
    EXPECT_EQ(blendedOver(0xFF000000U, {200, 100, 50, 255}, 0.5F),
              0xFF000000U | 100U | 50U << 8 | 25U << 16);
    // Half a line over half of another: three quarters are covered, two thirds of it by the upper.
    EXPECT_EQ(blendedOver(0x80000000U, {255, 255, 255, 255}, 0.5F) >> 24, 192U);
    EXPECT_NEAR(blendedOver(0x80000000U, {255, 255, 255, 255}, 0.5F) & 255U, 170.0, 1.0);
}

} // namespace
} // namespace quarn
