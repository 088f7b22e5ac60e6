#include "tests/engine/display/LitScenes.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

constexpr int SIZE = 64;

SceneContent inPicture(std::shared_ptr<const EnvironmentPicture> picture) {
    SceneContent content = cubeOnGround();
    content.light.surroundings = Surroundings::picture;
    content.light.picture = std::move(picture);
    return content;
}

std::shared_ptr<const EnvironmentPicture> evenPicture(float light) {
    return surroundingsBy([=](float, float) { return std::array<float, 3>{light, light, light}; });
}

/// The middle pixel of a camera that looks from far above the box to an azimuth.
std::array<int, 3> seenToward(const SceneContent& content, double azimuth_deg) {
    const double a = azimuth_deg * KM_PI / 180.0;
    const Image image =
        litPicture(content, perspectiveView({0, 0, 50}, {std::sin(a), std::cos(a), 50}), 32, 32);
    const auto pixel = image.pixel(16, 16);
    return {pixel[0], pixel[1], pixel[2]};
}

TEST(SurroundingPicture, ItsMiddleLiesTowardPlusYAndItsRightTowardPlusX) {
    const SceneContent content = inPicture(surroundingsBy([](float azimuth, float) {
        const bool is_north = std::abs(azimuth) < 45.0F;
        const bool is_east = std::abs(azimuth - 90.0F) < 45.0F;
        return std::array<float, 3>{is_north ? 1.0F : 0.1F, is_east ? 1.0F : 0.1F, 0.1F};
    }));
    const auto north = seenToward(content, 0.0);
    EXPECT_GT(north[0], north[1] + 100);
    const auto east = seenToward(content, 90.0);
    EXPECT_GT(east[1], east[0] + 100);
    const auto south = seenToward(content, 180.0);
    EXPECT_EQ(south[0], south[1]);
    EXPECT_LT(south[0], north[0] - 60);
}

TEST(SurroundingPicture, WhiteThingsVanishInEvenLight) {
    SceneContent content;
    content.light.surroundings = Surroundings::picture;
    content.light.picture = evenPicture(0.5F);
    content.light.has_ground = false;
    addMesh(content, sphereMesh({0, 0, 0}, 0.1F, 32), {255, 255, 255, 255});
    for (const float roughness : {0.0F, 0.3F, 1.0F})
        addLook(content, sphereMesh({0.3 + 0.3 * roughness, 0, 0.5 * roughness}, 0.1F, 32),
                [=](Material& material) {
                    material.base_color = {255, 255, 255, 255};
                    material.metalness = 1.0F;
                    material.roughness = roughness;
                });
    const Image image =
        litPicture(content, perspectiveView({0.2, -1.2, 0.2}, {0.2, 0, 0.2}), SIZE, SIZE);
    for (int y = 0; y < SIZE; ++y)
        for (int x = 0; x < SIZE; ++x)
            ASSERT_NEAR(brightness(image, x, y), brightness(image, 0, 0), 1.5) << x << ' ' << y;
}

TEST(SurroundingPicture, HowBrightItIsAllInAllMakesNoDifference) {
    const auto picture = [](float scale) {
        return surroundingsBy([=](float azimuth, float altitude) {
            return std::array<float, 3>{scale * (2.0F + 0.01F * azimuth),
                                        scale * (2.0F + 0.01F * altitude), scale};
        });
    };
    const Image dim = litPicture(inPicture(picture(0.01F)), productView(), SIZE, SIZE);
    const Image bright = litPicture(inPicture(picture(2000.0F)), productView(), SIZE, SIZE);
    for (int y = 0; y < SIZE; ++y)
        for (int x = 0; x < SIZE; ++x)
            ASSERT_NEAR(brightness(dim, x, y), brightness(bright, x, y), 1.0);
}

TEST(SurroundingPicture, ASmallBrightSpotIsASunThatCastsShadows) {
    // The spot stands in the east, 45 degrees high.
    double solid_angle = 0.0;
    const SceneContent content = inPicture(surroundingsBy([&](float azimuth, float altitude) {
        const bool is_sun = std::hypot(azimuth - 90.0F, altitude - 45.0F) < 2.5F;
        const double step = 2.0 * KM_PI / 256.0;
        solid_angle += is_sun ? step * step * std::cos(altitude * KM_PI / 180.0) : 0.0;
        const float light = is_sun ? 3000.0F : 0.5F;
        return std::array<float, 3>{light, light, light};
    }));
    const LitFrame lit = frameOf(content, productView());
    ASSERT_EQ(lit.frame.sun_count, 1);
    EXPECT_NEAR(lit.frame.suns[0].toward[0], std::sqrt(0.5), 0.01);
    EXPECT_NEAR(lit.frame.suns[0].toward[2], std::sqrt(0.5), 0.01);
    // What it sheds: its light times its solid angle over pi, beside the mean of all else.
    const double expected = 3000.0 * solid_angle / KM_PI / 0.5;
    EXPECT_NEAR(lit.frame.suns[0].color[1] / ambientOn(lit.frame, 0, 0, 1), expected,
                0.04 * expected);
    const Image image = litPicture(content, topView(0.5), SIZE, SIZE);
    const int west = SIZE / 2 - SIZE / 5;
    const int east = SIZE / 2 + SIZE / 5;
    EXPECT_LT(brightness(image, west, SIZE / 2), brightness(image, east, SIZE / 2) - 60.0);
}

TEST(SurroundingPicture, LightsOfAStudioAreNoSun) {
    const LitFrame lit = frameOf(inPicture(surroundingsBy([](float azimuth, float altitude) {
                                     const bool is_box =
                                         std::abs(std::abs(azimuth) - 60.0F) < 15.0F &&
                                         std::abs(altitude - 40.0F) < 15.0F;
                                     const float light = is_box ? 20.0F : 0.05F;
                                     return std::array<float, 3>{light, light, light};
                                 })),
                                 productView());
    EXPECT_EQ(lit.frame.sun_count, 0);
}

TEST(SurroundingPicture, NumbersThatNoLampSendsAndPicturesOfNothingAreDrawn) {
    const Image black = litPicture(inPicture(evenPicture(0.0F)), productView(), SIZE, SIZE);
    EXPECT_EQ(meanBrightness(black), 0.0);
    const Image huge = litPicture(inPicture(evenPicture(1e38F)), productView(), SIZE, SIZE);
    const Image plain = litPicture(inPicture(evenPicture(1.0F)), productView(), SIZE, SIZE);
    EXPECT_NEAR(meanBrightness(huge), meanBrightness(plain), 1.0);
    const SceneContent spotted = inPicture(surroundingsBy([](float azimuth, float altitude) {
        const float light = std::hypot(azimuth, altitude - 60.0F) < 3.0F ? 1e38F : 1.0F;
        return std::array<float, 3>{light, light, light};
    }));
    const Image spot = litPicture(spotted, productView(), SIZE, SIZE);
    EXPECT_GT(meanBrightness(spot), 5.0);
    EXPECT_LT(meanBrightness(spot), 250.0);
}

TEST(SurroundingPicture, OneOfVeryManyPixelsLooksAsItsSmallerOne) {
    const auto striped = [](int width, int pixels_a_stripe) {
        auto picture = std::make_shared<EnvironmentPicture>();
        picture->width = width;
        picture->height = 2;
        for (int i = 0; i < 2 * width; ++i)
            for (int c = 0; c < 3; ++c)
                picture->rgb.push_back(i % width / pixels_a_stripe % 2 == c % 2 ? 0.2F : 1.0F);
        return inPicture(picture);
    };
    const Image large = litPicture(striped(8192, 512), productView(), SIZE, SIZE);
    const Image small = litPicture(striped(2048, 128), productView(), SIZE, SIZE);
    for (int y = 0; y < SIZE; ++y)
        for (int x = 0; x < SIZE; ++x)
            ASSERT_NEAR(brightness(large, x, y), brightness(small, x, y), 8.0) << x << ' ' << y;
    EXPECT_NEAR(meanBrightness(large), meanBrightness(small), 0.5);
}

TEST(SurroundingPicture, APictureOfOnePixelIsOneLightFromAllSides) {
    auto picture = std::make_shared<EnvironmentPicture>(EnvironmentPicture{1, 1, {1, 0.5F, 0.25F}});
    const LitFrame lit = frameOf(inPicture(picture), productView());
    EXPECT_NEAR(ambientOn(lit.frame, 0, 0, 1), ambientOn(lit.frame, 1, 0, 0), 1e-3);
    EXPECT_NEAR(lit.frame.ambient_base[0], 4.0 * lit.frame.ambient_base[2], 1e-3);
}

} // namespace
} // namespace quarn
