#include "tests/engine/display/LookScenes.h"

#include "engine/images/ColorSpace.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

/// The byte that scene light is shown as.
double shownByte(float scene_light) {
    return srgbByteFromLinear(toneMapped(scene_light));
}

/// A floor that fills the picture, seen from above.
Image floorOf(const std::function<void(Material&)>& change, const KM_3dVector& sun_shines_to,
              const wchar_t* mode = L"Rendered") {
    SceneContent content;
    KM_Mesh floor = floorMesh(-9, -9, 9, 9, 0);
    floor.m_T = {{0.0F, 0.0F}, {1.0F, 0.0F}, {1.0F, 1.0F}, {0.0F, 1.0F}};
    addLook(content, std::move(floor), change);
    content.lights.push_back(sunLight(sun_shines_to));
    return drawn(content, topView(5.0), modeNamed(mode), 40, 40);
}

const KM_3dVector noon{0.2, 0.3, -1.0};
const KM_3dVector midnight{0.2, 0.3, 1.0};

TEST(Unlit, SurfaceShowsItsBaseColourWhateverTheLight) {
    const auto unlit = [](Material& material) {
        material.base_color = {200, 120, 40, 255};
        material.is_unlit = true;
    };
    for (const wchar_t* const mode : {L"Rendered", L"Shaded"})
        for (const KM_3dVector& sun : {noon, midnight}) {
            const Image image = floorOf(unlit, sun, mode);
            EXPECT_NEAR(image.pixel(20, 20)[0], 200, 1);
            EXPECT_NEAR(image.pixel(20, 20)[1], 120, 1);
            EXPECT_NEAR(image.pixel(20, 20)[2], 40, 1);
        }
}

TEST(Unlit, WhiteStaysWhite) {
    const Image image = floorOf(
        [](Material& material) {
            material.base_color = {255, 255, 255, 255};
            material.is_unlit = true;
        },
        midnight);
    EXPECT_GE(image.pixel(20, 20)[0], 253);
}

TEST(Emission, IsAddedToTheLightThatTheSurfaceScatters) {
    const auto black = [](Material& material) { material.base_color = {0, 0, 0, 255}; };
    const auto glowing = [](Material& material) {
        material.base_color = {0, 0, 0, 255};
        material.emission = {0.5F, 0.25F, 0.0F};
    };
    for (const wchar_t* const mode : {L"Rendered", L"Shaded"}) {
        EXPECT_LE(floorOf(black, noon, mode).pixel(20, 20)[0], 2);
        const Image image = floorOf(glowing, noon, mode);
        EXPECT_NEAR(image.pixel(20, 20)[0], shownByte(0.5F), 1);
        EXPECT_NEAR(image.pixel(20, 20)[1], shownByte(0.25F), 1);
        EXPECT_LE(image.pixel(20, 20)[2], 2);
    }
}

TEST(Emission, OfTheStrengthOfASunIsWhiteAndNoError) {
    const Image image = floorOf(
        [](Material& material) {
            material.emission = {1e30F, 1e30F, 1e30F};
        },
        midnight);
    EXPECT_EQ(image.pixel(20, 20)[0], 255);
    EXPECT_EQ(image.pixel(20, 20)[2], 255);
}

std::shared_ptr<const Texture> whiteOnTheLeft() {
    return textureOf(16, 1, [](int x, int) {
        const std::uint8_t value = x < 8 ? 255 : 0;
        return std::array<std::uint8_t, 4>{value, value, value, 255};
    });
}

TEST(Emission, ComesFromTheBrightPartsOfItsTexture) {
    const Image image = floorOf(
        [](Material& material) {
            material.base_color = {0, 0, 0, 255};
            material.emission = {0.5F, 0.5F, 0.5F};
            material.emission_texture.texture = whiteOnTheLeft();
        },
        noon);
    EXPECT_NEAR(image.pixel(8, 20)[0], shownByte(0.5F), 1);
    EXPECT_LE(image.pixel(32, 20)[0], 2);
}

TEST(Emission, TextureLiesWhereItsTransformPutsIt) {
    const Image image = floorOf(
        [](Material& material) {
            material.base_color = {0, 0, 0, 255};
            material.emission = {0.5F, 0.5F, 0.5F};
            material.emission_texture.texture = whiteOnTheLeft();
            material.emission_texture.u = {-1.0F, 0.0F, 1.0F};
        },
        noon);
    EXPECT_LE(image.pixel(8, 20)[0], 2);
    EXPECT_NEAR(image.pixel(32, 20)[0], shownByte(0.5F), 1);
}

TEST(Emission, TextureWithoutAllItsTexelsCountsAsNone) {
    const Image image = floorOf(
        [](Material& material) {
            material.base_color = {0, 0, 0, 255};
            material.emission = {0.5F, 0.5F, 0.5F};
            auto texture = std::make_shared<Texture>();
            texture->width = texture->height = 8;
            texture->rgba = {1, 2, 3};
            material.emission_texture.texture = texture;
        },
        noon);
    EXPECT_NEAR(image.pixel(20, 20)[0], shownByte(0.5F), 1);
}

/// Seven bars of a sign: which of them a letter has.
std::array<std::uint8_t, 4> letters(int x, int y) {
    const bool is_border = x < 2 || y < 2 || x >= 62 || y >= 14;
    const bool is_stroke = (x / 4) % 3 == 1 && y > 3 && y < 12 && (x / 12 + y / 4) % 4 != 3;
    const std::uint8_t value = is_border || is_stroke ? 255 : 0;
    return {value, value, value, 255};
}

TEST(Emission, SignShinesAtNight) {
    SceneContent content;
    addMesh(content, boxMesh({-3, 0.05, 0}, {3, 1, 3}), {120, 110, 100, 255});
    KM_Mesh sign = wallMesh(-2, 2, 0, 1);
    for (KM_3fPoint& p : sign.m_V)
        p.z += 1.2F;
    addLook(content, std::move(sign), [](Material& material) {
        material.base_color = {20, 20, 20, 255};
        material.emission = {2.5F, 0.5F, 0.3F};
        material.emission_texture.texture = textureOf(64, 16, letters);
    });
    content.lights.push_back(sunLight(midnight));
    const KM_Viewport view = perspectiveView({2.0, -8.0, 2.0}, {0.0, 0.0, 1.5});
    const Image image = drawn(content, view, modeNamed(L"Rendered", 2), 640, 400);
    show(image, "sign");
    int bright = 0;
    for (int y = 0; y < image.height; ++y)
        for (int x = 0; x < image.width; ++x)
            bright += image.pixel(x, y)[0] > 230 ? 1 : 0;
    EXPECT_GT(bright, 2000);
}

} // namespace
} // namespace quarn
