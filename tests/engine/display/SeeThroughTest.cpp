#include "tests/engine/display/DisplayFixture.h"

#include "engine/images/ColorSpace.h"

#include <gtest/gtest.h>

#include <array>
#include <cmath>

namespace quarn {
namespace {

constexpr KM_Color wall_color{60, 90, 190, 255};

/// A view from above shows 100 pixels for x and y from -5 to 5.
Image seen(const SceneContent& content, const wchar_t* mode = L"Rendered") {
    return drawn(content, topView(5.0), modeNamed(mode), 100, 100);
}

/// Scene light of a pixel's channel.
double lightAt(const Image& image, int x, int y, int channel) {
    return sceneLightShownAs(
        linearFromSrgbByte(image.pixel(x, y)[static_cast<std::size_t>(channel)]));
}

std::size_t addPane(SceneContent& content, KM_Mesh mesh, KM_Color color) {
    const std::size_t index = addMesh(content, std::move(mesh), color);
    auto material = std::make_shared<Material>(*content.meshes[index].placed.material);
    material->see_through = true;
    content.meshes[index].placed.material = material;
    return index;
}

SceneContent only(float height, KM_Color color) {
    SceneContent content;
    addMesh(content, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, height), color);
    return content;
}

KM_Color opaque(KM_Color color) {
    color.a = 255;
    return color;
}

/// How opaque a color says that it is.
double share(KM_Color color) {
    return color.a / 255.0;
}

void expectLight(const Image& image, int x, int y, const std::array<double, 3>& light) {
    for (int c = 0; c < 3; ++c) {
        const double wanted = light[static_cast<std::size_t>(c)];
        EXPECT_NEAR(lightAt(image, x, y, c), wanted, 0.012 * wanted + 0.004) << "channel " << c;
    }
}

constexpr KM_Color red_pane{220, 60, 40, 128};
constexpr KM_Color green_pane{40, 200, 80, 64};

class PanesInAMode : public testing::TestWithParam<const wchar_t*> {};

TEST_P(PanesInAMode, APaneCoversAsMuchOfTheWallBehindItAsItIsOpaque) {
    SceneContent content = only(0.0F, wall_color);
    const Image wall = seen(content, GetParam());
    const Image pane = seen(only(2.0F, opaque(red_pane)), GetParam());
    addPane(content, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 2.0F), red_pane);
    const double a = share(red_pane);
    std::array<double, 3> blend{};
    for (int c = 0; c < 3; ++c)
        blend[static_cast<std::size_t>(c)] =
            a * lightAt(pane, 50, 50, c) + (1.0 - a) * lightAt(wall, 50, 50, c);
    expectLight(seen(content, GetParam()), 50, 50, blend);
}

TEST_P(PanesInAMode, TheNearerOfTwoPanesCoversTheOther) {
    const auto alone = [&](KM_Color color) { return seen(only(0.0F, opaque(color)), GetParam()); };
    const Image wall = alone(wall_color);
    for (const bool red_first : {true, false}) {
        const KM_Color near = red_first ? red_pane : green_pane;
        const KM_Color far = red_first ? green_pane : red_pane;
        SceneContent content = only(0.0F, wall_color);
        addPane(content, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 1.0F), far);
        addPane(content, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 2.0F), near);
        const Image near_alone = alone(near);
        const Image far_alone = alone(far);
        std::array<double, 3> blend{};
        for (int c = 0; c < 3; ++c) {
            const double behind = share(far) * lightAt(far_alone, 50, 50, c) +
                                  (1.0 - share(far)) * lightAt(wall, 50, 50, c);
            blend[static_cast<std::size_t>(c)] =
                share(near) * lightAt(near_alone, 50, 50, c) + (1.0 - share(near)) * behind;
        }
        expectLight(seen(content, GetParam()), 50, 50, blend);
    }
}

INSTANTIATE_TEST_SUITE_P(SeeThrough, PanesInAMode, testing::Values(L"Rendered", L"Shaded"));

TEST(SeeThrough, ClayIsOpaque) {
    SceneContent content = only(0.0F, wall_color);
    addMesh(content, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 2.0F), red_pane);
    const Image opaque_pane = seen(content, L"Clay");
    SceneContent panes = only(0.0F, wall_color);
    addPane(panes, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 2.0F), red_pane);
    EXPECT_EQ(opaque_pane.rgba, seen(panes, L"Clay").rgba);
}

TEST(SeeThrough, TheBackgroundShowsThroughAPane) {
    SceneContent nothing = only(0.0F, wall_color);
    nothing.meshes[0].visible = false;
    DisplayModeAttributes mode = modeNamed(L"Shaded");
    mode.has_ground_plane = false;
    const auto picture = [&](const SceneContent& content) {
        return drawn(content, topView(5.0), mode, 100, 100);
    };
    const Image background = picture(nothing);
    const Image pane = picture(only(0.0F, opaque(red_pane)));
    SceneContent content;
    addPane(content, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 0.0F), red_pane);
    std::array<double, 3> blend{};
    for (int c = 0; c < 3; ++c)
        blend[static_cast<std::size_t>(c)] =
            share(red_pane) * lightAt(pane, 50, 50, c) +
            (1.0 - share(red_pane)) * lightAt(background, 50, 50, c);
    expectLight(picture(content), 50, 50, blend);
}

/// Panes to the east of a floor, whose shadows a slanting sun throws on it, in rows of their own.
SceneContent floorUnderPanes(const std::array<KM_Color, 4>& panes, bool see_through) {
    SceneContent content = only(0.0F, {204, 204, 204, 255});
    for (int i = 0; i < 4; ++i) {
        const float y = static_cast<float>(-4 + 2 * i);
        const auto add = see_through ? addPane : addMesh;
        add(content, floorMesh(5.0F, y, 8.0F, y + 2.0F, 5.0F), panes[static_cast<std::size_t>(i)]);
    }
    content.lights.push_back(sunLight({-1.0, 0.0, -1.0}));
    return content;
}

TEST(SeeThrough, SunlightPassesAPaneAsFarAsItIsNotOpaque) {
    const std::array<KM_Color, 4> panes{KM_Color{255, 255, 255, 0}, KM_Color{255, 255, 255, 64},
                                        KM_Color{255, 255, 255, 128}, KM_Color{255, 255, 255, 230}};
    const Image shadows = seen(floorUnderPanes(panes, false));
    const Image dimmed = seen(floorUnderPanes(panes, true));
    for (int i = 0; i < 4; ++i) {
        const int y = 80 - 20 * i; // the middle of the pane's shadow, which reaches from x = 0 to 3
        const double shadow = lightAt(shadows, 65, y, 1);
        const double open = lightAt(dimmed, 25, y, 1);
        ASSERT_GT(open, 1.5 * shadow);
        const double wanted = open - share(panes[static_cast<std::size_t>(i)]) * (open - shadow);
        EXPECT_NEAR(lightAt(dimmed, 65, y, 1), wanted, 0.015 * wanted) << "pane " << i;
    }
}

TEST(SeeThrough, APaneHasTheOpacityOfItsTexture) {
    SceneContent content = only(0.0F, wall_color);
    const Image wall = seen(content);
    KM_Mesh mesh = floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 2.0F);
    mesh.m_T = {{0.0F, 0.0F}, {1.0F, 0.0F}, {1.0F, 1.0F}, {0.0F, 1.0F}};
    const std::size_t pane = addPane(content, std::move(mesh), {255, 255, 255, 255});
    auto texture = std::make_shared<Texture>();
    texture->width = 2;
    texture->height = 1; // the left half is clear
    texture->rgba = {255, 0, 0, 0, 255, 0, 0, 255};
    texture->wrap_u = TextureWrap::clamp;
    auto material = std::make_shared<Material>(*content.meshes[pane].placed.material);
    material->base_color_texture = texture;
    content.meshes[pane].placed.material = material;
    const Image image = seen(content);
    expectLight(image, 15, 50,
                {lightAt(wall, 15, 50, 0), lightAt(wall, 15, 50, 1), lightAt(wall, 15, 50, 2)});
    EXPECT_GT(image.pixel(85, 50)[0], image.pixel(85, 50)[2] + 100);
}

TEST(SeeThrough, WhatStandsFarFromAPaneIsDrawnAsWithoutIt) {
    SceneContent content;
    addMesh(content, sphereMesh({-2.0, 0.0, 0.0}, 1.5F, 20), wall_color);
    addMesh(content, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, -2.0F));
    content.lights.push_back(sunLight({0.0, 0.0, -1.0}));
    const DisplayModeAttributes mode = modeNamed(L"Rendered", 2);
    const Image without = drawn(content, topView(5.0), mode, 100, 100);
    addPane(content, floorMesh(2.0F, -1.0F, 3.0F, 1.0F, 0.0F), red_pane);
    const Image with = drawn(content, topView(5.0), mode, 100, 100);
    int differing = 0;
    for (int y = 0; y < 100; ++y)
        for (int x = 0; x < 64; ++x)
            differing += samePixel(with, x, y, without, x, y) ? 0 : 1;
    EXPECT_EQ(0, differing);
    EXPECT_FALSE(samePixel(with, 75, 50, without, 75, 50));
}

TEST(SeeThrough, BordersOfThingsBehindAPaneAreSmooth) {
    SceneContent content;
    KM_Mesh slanted;
    slanted.m_V = {{-4.0F, -4.0F, 0.0F}, {4.0F, -4.0F, 0.0F}, {-1.0F, 4.0F, 0.0F}};
    slanted.m_F = {{{0, 1, 2}}};
    addMesh(content, std::move(slanted), {20, 20, 20, 255});
    addPane(content, floorMesh(-5.0F, -5.0F, 5.0F, 5.0F, 1.0F), {255, 255, 255, 64});
    const Image image = drawn(content, topView(5.0), modeNamed(L"Shaded", 2), 100, 100);
    // Every row crosses the right border once: most of them somewhere within a pixel.
    int between = 0;
    for (int y = 20; y < 80; ++y) {
        const double dark = brightness(image, 45, y);
        const double light = brightness(image, 97, y);
        ASSERT_GT(light, dark + 40.0);
        for (int x = 46; x < 97; ++x)
            between += brightness(image, x, y) > dark + 8.0 && brightness(image, x, y) < light - 8.0
                           ? 1
                           : 0;
    }
    EXPECT_GT(between, 40);
}

TEST(SeeThrough, LinesShowThroughAPane) {
    SceneContent content;
    addPane(content, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 2.0F), red_pane);
    const Image without = seen(content);
    SceneCurve curve;
    curve.id = KM_CreateUuid();
    curve.polyline.Append(KM_3dPoint(-3.0, 0.0, 1.0));
    curve.polyline.Append(KM_3dPoint(3.0, 0.0, 1.0));
    content.curves.push_back(curve);
    const Image with = seen(content);
    EXPECT_LT(brightness(with, 50, 50), brightness(without, 50, 50) - 30.0);
}

} // namespace
} // namespace quarn
