#include "tests/engine/display/LookScenes.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>

namespace quarn {
namespace {

constexpr int size = 96;
const KM_3dVector shines_to{0.4, 0.6, -0.7};

/// A checkered wall on a floor, and what may stand before it.
SceneContent stage(const std::function<void(SceneContent&)>& add) {
    SceneContent content;
    addMesh(content, floorMesh(-9, -6, 9, 6, 0), {170, 160, 140, 255});
    KM_Mesh wall = wallMesh(-5, 5, 4, 6);
    addLook(content, std::move(wall), [](Material& material) {
        material.base_color = {255, 255, 255, 255};
        material.base_color_texture = textureOf(64, 64, [](int x, int y) {
            const std::uint8_t value = (x / 8 + y / 8) % 2 == 0 ? 220 : 60;
            return std::array<std::uint8_t, 4>{value, 120, 90, 255};
        });
    });
    add(content);
    content.lights.push_back(sunLight(shines_to));
    return content;
}

Image seen(const SceneContent& content, const wchar_t* mode = L"Rendered") {
    return drawn(content, perspectiveView({0.0, -12.0, 3.0}, {0.0, 2.0, 2.5}), modeNamed(mode),
                 size, size);
}

void addBall(SceneContent& content, const std::function<void(Material&)>& change) {
    addLook(content, sphereMesh({0.0, 0.0, 2.5}, 2.0F, 32), [&](Material& material) {
        material.base_color = {255, 255, 255, 255};
        material.transmission = 1.0F;
        material.roughness = 0.0F;
        change(material);
    });
}

Image withBall(const std::function<void(Material&)>& change, const wchar_t* mode = L"Rendered") {
    return seen(stage([&](SceneContent& content) { addBall(content, change); }), mode);
}

Image withoutBall(const wchar_t* mode = L"Rendered") {
    return seen(stage([](SceneContent&) {}), mode);
}

int differing(const Image& a, const Image& b, int least = 1) {
    int count = 0;
    for (int y = 0; y < size; ++y)
        for (int x = 0; x < size; ++x) {
            int step = 0;
            for (std::size_t c = 0; c < 3; ++c)
                step = std::max(step, std::abs(a.pixel(x, y)[c] - b.pixel(x, y)[c]));
            count += step >= least ? 1 : 0;
        }
    return count;
}

TEST(Glass, WhiteAndOfIndexOneIsInvisibleWhateverItsRoughness) {
    for (const wchar_t* const mode : {L"Rendered", L"Shaded"})
        for (const float roughness : {0.0F, 0.3F, 1.0F})
            EXPECT_EQ(differing(withoutBall(mode), withBall(
                                                       [&](Material& material) {
                                                           material.index_of_refraction = 1.0F;
                                                           material.roughness = roughness;
                                                       },
                                                       mode)),
                      0)
                << roughness;
}

TEST(Glass, ShowsWhatStandsBehindItAndMirrorsItsSurroundingsAtTheRim) {
    const Image glass = withBall([](Material&) {});
    show(glass, "glass");
    const Image nothing = withoutBall();
    // In the middle two surfaces mirror 4 % each.
    EXPECT_NEAR(brightness(glass, 48, 48), brightness(nothing, 48, 48), 30.0);
    EXPECT_GT(differing(glass, nothing, 40), 50);
    EXPECT_GT(differing(glass, nothing, 1), 500);
}

TEST(Glass, ColourOfTheSurfaceStainsWhatComesThrough) {
    const Image clear = withBall([](Material&) {});
    const Image green = withBall([](Material& material) {
        material.base_color = {60, 220, 90, 255};
    });
    EXPECT_LT(green.pixel(48, 48)[0], clear.pixel(48, 48)[0] - 30);
    EXPECT_LT(std::abs(green.pixel(48, 48)[1] - clear.pixel(48, 48)[1]), 40);
}

TEST(Glass, InsideTakesLightByItsThicknessAndDistance) {
    const auto red = [](float thickness, float distance) {
        return withBall([&](Material& material) {
                   material.thickness = thickness;
                   material.attenuation_distance = distance;
                   material.attenuation_color = {0.3F, 0.9F, 0.9F};
               })
            .pixel(48, 48)[0];
    };
    const int clear = red(1.0F, std::numeric_limits<float>::infinity());
    EXPECT_EQ(red(0.0F, 1.0F), clear);
    EXPECT_LT(red(1.0F, 1.0F), clear - 10);
    EXPECT_LT(red(4.0F, 1.0F), red(1.0F, 1.0F) - 10);
    EXPECT_EQ(red(4.0F, 4.0F), red(1.0F, 1.0F));
}

TEST(Glass, TextureOfTheThicknessSaysHowMuchTheInsideTakes) {
    const auto picture = [](float thickness, std::uint8_t green) {
        SceneContent content = stage([&](SceneContent& to) {
            addLook(to, wallMesh(-3, 3, 0, 5), [&](Material& material) {
                material.base_color = {255, 255, 255, 255};
                material.transmission = 1.0F;
                material.roughness = 0.0F;
                material.thickness = thickness;
                material.attenuation_distance = 1.0F;
                material.attenuation_color = {0.3F, 0.9F, 0.9F};
                if (green < 255)
                    material.thickness_texture.texture = textureOf(4, 4, [&](int, int) {
                        return std::array<std::uint8_t, 4>{0, green, 0, 255};
                    });
            });
        });
        content.lights.clear(); // shadows go by the number alone
        return seen(content);
    };
    EXPECT_LE(differing(picture(2.0F, 51), picture(0.4F, 255), 2), 0);
    EXPECT_GT(differing(picture(2.0F, 51), picture(2.0F, 255), 5), 500);
}

/// How much the middle of the ball varies.
double contrastWithin(const Image& image) {
    double least = 255.0;
    double most = 0.0;
    for (int x = 42; x < 54; ++x)
        for (int y = 42; y < 54; ++y) {
            least = std::min(least, brightness(image, x, y));
            most = std::max(most, brightness(image, x, y));
        }
    return most - least;
}

TEST(Glass, FrostedGlassShowsNoPictureOfWhatStandsBehind) {
    const auto contrast = [](float roughness) {
        return contrastWithin(
            withBall([&](Material& material) { material.roughness = roughness; }));
    };
    EXPECT_GT(contrast(0.0F), 25.0);
    EXPECT_LT(contrast(0.6F), 12.0);
    EXPECT_LT(contrast(0.35F), contrast(0.1F));
}

TEST(Glass, LetsTheSunPassOntoTheFloor) {
    const auto floorLight = [](float transmission) {
        SceneContent content;
        addMesh(content, floorMesh(-9, -9, 9, 9, 0));
        addLook(content, floorMesh(5, -2, 8, 2, 5), [&](Material& material) {
            material.base_color = {255, 255, 255, 255};
            material.transmission = transmission;
            material.roughness = 0.0F;
        });
        content.lights.push_back(sunLight({-1.0, 0.0, -1.0}));
        const Image image = drawn(content, topView(5.0), modeNamed(L"Rendered"), size, size);
        return brightness(image, 62, 48); // its shadow reaches from x = 0 to 3
    };
    EXPECT_GT(floorLight(1.0F), floorLight(0.0F) + 40.0);
    EXPECT_GT(floorLight(0.5F), floorLight(0.0F) + 15.0);
    EXPECT_LT(floorLight(0.5F), floorLight(1.0F) - 15.0);
}

TEST(Glass, OfNumbersBeyondMeasureIsDrawnAsGlass) {
    const auto glass = [](float thickness, float distance, const LinearRgb& color) {
        return withBall([&](Material& material) {
            material.thickness = thickness;
            material.attenuation_distance = distance;
            material.attenuation_color = color;
        });
    };
    const float infinity = std::numeric_limits<float>::infinity();
    const Image clear = glass(0.0F, infinity, {1, 1, 1});
    EXPECT_EQ(clear.rgba, glass(1e30F, 1e-30F, {1, 1, 1}).rgba);
    EXPECT_EQ(clear.rgba, glass(0.0F, 1e-30F, {0, 0, 0}).rgba);
    EXPECT_EQ(clear.rgba, glass(1e30F, infinity, {0, 0, 0}).rgba);
    const Image black = glass(1e30F, 1e-30F, {0, 0, 0});
    EXPECT_EQ(black.rgba, glass(10.0F, 1e-3F, {0, 0, 0}).rgba);
    EXPECT_LT(brightness(black, 48, 48), brightness(clear, 48, 48) - 20.0);
    // Red alone passes, undimmed.
    EXPECT_EQ(glass(1e30F, 1e-30F, {1, 0, 0}).pixel(48, 48)[0], clear.pixel(48, 48)[0]);
}

TEST(Glass, IsSeenThroughInShadedAndSolidInClay) {
    const auto green = [](Material& material) { material.base_color = {60, 220, 90, 255}; };
    EXPECT_GT(contrastWithin(withBall(green, L"Shaded")), 10.0);
    const auto solid = [&](Material& material) {
        green(material);
        material.transmission = 0.0F;
    };
    EXPECT_EQ(withBall(green, L"Clay").rgba, withBall(solid, L"Clay").rgba);
}

} // namespace
} // namespace quarn
