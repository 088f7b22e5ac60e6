#include "tests/engine/display/LookScenes.h"

#include "engine/display/Environment.h"
#include "engine/display/FrameSetupBuilder.h"
#include "engine/images/ColorSpace.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

namespace quarn {
namespace {

constexpr int size = 96;

/// A ball that nearly fills the picture, seen level.
SceneContent ball(const std::function<void(Material&)>& change) {
    SceneContent content;
    addLook(content, sphereMesh({0.0, 0.0, 0.0}, 4.0F, 64), change);
    return content;
}

KM_Viewport levelView() {
    KM_Viewport view = perspectiveView({0.0, -30.0, 0.0}, {0.0, 0.0, 0.0});
    view.SetProjection(KM_parallel_view);
    view.SetFrustum(-5.0, 5.0, -5.0, 5.0, 1.0, 100.0);
    return view;
}

Image ballPicture(const std::function<void(Material&)>& change,
                  const KM_3dVector& sun_shines_to = {0.5, 0.6, -0.6}) {
    SceneContent content = ball(change);
    content.lights.push_back(sunLight(sun_shines_to));
    return drawn(content, levelView(), modeNamed(L"Rendered"), size, size);
}

/// The same light from everywhere.
void fillWith(FrameSetup& frame, float light) {
    frame.sun_count = 0;
    frame.fixed_count = 0;
    frame.soft_box_count = 0;
    frame.has_ground = false;
    for (int c = 0; c < 3; ++c) {
        frame.sky_horizon[c] = frame.sky_zenith[c] = frame.sky_nadir[c] = light;
        frame.sky_side[c] = frame.sky_glow[c] = frame.sky_disc[c] = 0.0F;
        frame.ambient_base[c] = light;
        std::fill_n(frame.ambient_slope[c], 3, 0.0F);
    }
}

/// A ball in even light; the corners show that light alone.
Image inFurnace(const std::function<void(Material&)>& change) {
    DisplayScene scene;
    EXPECT_TRUE(scene.update(ball(change)).ok());
    FrameSetup frame = makeFrameSetup(scene, levelView(), modeNamed(L"Rendered"), size, size);
    EXPECT_TRUE(frame.has_mirrors);
    fillWith(frame, 0.5F);
    Image image;
    image.resize(size, size);
    frame.pixels = reinterpret_cast<std::uint32_t*>(image.rgba.data());
    Environment environment;
    environment.find(frame, baseline_ray_kernel);
    baseline_ray_kernel.trace_block(frame, {0, 0, size, size});
    return image;
}

/// One step of a byte at this light is 1.1 % of it.
void expectVanishes(const Image& image) {
    for (int y = 0; y < size; ++y)
        for (int x = 0; x < size; ++x)
            for (std::size_t c = 0; c < 3; ++c)
                ASSERT_NEAR(image.pixel(x, y)[c], image.pixel(0, 0)[c], 1)
                    << x << ' ' << y << ' ' << c;
}

TEST(WhiteFurnace, WhiteMetalOfEveryRoughnessVanishesInEvenLight) {
    for (const float roughness : {0.0F, 0.1F, 0.25F, 0.5F, 0.75F, 1.0F})
        expectVanishes(inFurnace([&](Material& material) {
            material.base_color = {255, 255, 255, 255};
            material.metalness = 1.0F;
            material.roughness = roughness;
        }));
}

TEST(WhiteFurnace, WhiteGlossOfEveryRoughnessVanishesInEvenLight) {
    for (const float roughness : {0.0F, 0.1F, 0.25F, 0.5F, 0.75F, 0.95F})
        expectVanishes(inFurnace([&](Material& material) {
            material.base_color = {255, 255, 255, 255};
            material.roughness = roughness;
        }));
}

TEST(WhiteFurnace, GreyMetalIsDarkerThanTheLightEverywhereButAtItsRim) {
    const Image image = inFurnace([](Material& material) {
        material.base_color = {128, 128, 128, 255};
        material.metalness = 1.0F;
        material.roughness = 0.3F;
    });
    EXPECT_LT(brightness(image, size / 2, size / 2), 0.6 * brightness(image, 0, 0));
    for (int y = 0; y < size; ++y)
        for (int x = 0; x < size; ++x)
            ASSERT_LE(brightness(image, x, y), brightness(image, 0, 0) + 1.0);
}

TEST(Mirroring, MaterialThatIsMattLooksAsWithoutAMaterial) {
    SceneContent content;
    addMesh(content, sphereMesh({0.0, 0.0, 0.0}, 4.0F, 64), {90, 140, 60, 255});
    content.lights.push_back(sunLight({0.5, 0.6, -0.6}));
    const Image plain = drawn(content, levelView(), modeNamed(L"Rendered"), size, size);
    const Image matt = ballPicture([](Material& material) {
        material.base_color = {90, 140, 60, 255};
    });
    EXPECT_EQ(plain.rgba, matt.rgba);
}

/// Mean brightness of a rectangle of the picture.
double meanOf(const Image& image, int x0, int y0, int x1, int y1) {
    double sum = 0.0;
    for (int y = y0; y < y1; ++y)
        for (int x = x0; x < x1; ++x)
            sum += brightness(image, x, y);
    return sum / ((x1 - x0) * (y1 - y0));
}

TEST(Mirroring, SmoothMetalShowsTheBlueSkyWhereItFacesUpAndTheGroundWhereItFacesDown) {
    const Image image = ballPicture([](Material& material) {
        material.base_color = {250, 250, 250, 255};
        material.metalness = 1.0F;
        material.roughness = 0.0F;
    });
    // The ball's radius is 38 pixels: tilted by 12 degrees the mirror looks 24 degrees up or down.
    const auto up = image.pixel(size / 2, size / 2 - 8);
    const auto down = image.pixel(size / 2, size / 2 + 8);
    EXPECT_GT(up[2], up[0] + 30);
    EXPECT_LT(std::abs(down[2] - down[0]), 30);
}

/// Pixels of the ball from some brightness on.
int brightPixels(const Image& image, int least) {
    int count = 0;
    for (int y = 0; y < size; ++y)
        for (int x = 0; x < size; ++x)
            count += std::hypot(x - 47.5, y - 47.5) < 37.0 && image.pixel(x, y)[1] >= least ? 1 : 0;
    return count;
}

TEST(Mirroring, HighlightOfTheSunIsWiderAndDimmerTheRougherTheSurfaceIs) {
    const auto plastic = [](float roughness) {
        return ballPicture([roughness](Material& material) {
            material.base_color = {0, 0, 0, 255};
            material.roughness = roughness;
        });
    };
    const Image sharp = plastic(0.15F);
    const Image soft = plastic(0.3F);
    const Image dull = plastic(0.95F);
    const Image matt = ballPicture([](Material& material) {
        material.base_color = {0, 0, 0, 255};
    });
    EXPECT_GT(brightPixels(sharp, 225), 5);
    EXPECT_GT(brightPixels(soft, 150), 1.5 * brightPixels(sharp, 150));
    EXPECT_EQ(brightPixels(dull, 150), 0);
    EXPECT_EQ(brightPixels(matt, 5), 0);
}

TEST(Mirroring, MetalColoursWhatItMirrorsAndPlasticDoesNot) {
    const auto red = [](float metalness) {
        return ballPicture([metalness](Material& material) {
            material.base_color = {220, 30, 30, 255};
            material.metalness = metalness;
            material.roughness = 0.25F;
        });
    };
    const auto brightest = [](const Image& image) {
        std::array<int, 3> color{};
        for (int y = 0; y < size; ++y)
            for (int x = 0; x < size; ++x)
                if (std::hypot(x - 47.5, y - 47.5) < 37.0 && image.pixel(x, y)[0] > color[0])
                    color = {image.pixel(x, y)[0], image.pixel(x, y)[1], image.pixel(x, y)[2]};
        return color;
    };
    const std::array<int, 3> metal = brightest(red(1.0F));
    const std::array<int, 3> plastic = brightest(red(0.0F));
    EXPECT_GT(metal[0], metal[1] + 80);
    EXPECT_LT(plastic[0] - plastic[1], metal[0] - metal[1]);
}

TEST(Mirroring, TextureSaysWhereItIsMetalAndHowRough) {
    const auto wall = [](std::uint8_t green, std::uint8_t blue) {
        SceneContent content;
        addLook(content, wallMesh(-4, 4, 0, 8), [&](Material& material) {
            material.base_color = {200, 60, 60, 255};
            material.metalness = material.roughness = 1.0F;
            material.metal_rough.texture = textureOf(4, 4, [&](int, int) {
                return std::array<std::uint8_t, 4>{0, green, blue, 255};
            });
        });
        content.lights.push_back(sunLight({0.3, 0.6, -0.6}));
        return drawn(content, levelView(), modeNamed(L"Rendered"), size, size);
    };
    const auto numbers = [](float metalness, float roughness) {
        SceneContent content;
        addLook(content, wallMesh(-4, 4, 0, 8), [&](Material& material) {
            material.base_color = {200, 60, 60, 255};
            material.metalness = metalness;
            material.roughness = roughness;
        });
        content.lights.push_back(sunLight({0.3, 0.6, -0.6}));
        return drawn(content, levelView(), modeNamed(L"Rendered"), size, size);
    };
    EXPECT_EQ(wall(102, 255).rgba, numbers(1.0F, 102.0F / 255.0F).rgba);
    EXPECT_EQ(wall(51, 0).rgba, numbers(0.0F, 51.0F / 255.0F).rgba);
    EXPECT_NE(wall(51, 0).rgba, wall(51, 255).rgba);
}

TEST(Mirroring, StrengthOfTheSpecularReflectionGoesByItsNumberAndTheIndexOfRefraction) {
    const auto mirrored = [](float specular, float index) {
        const Image image = ballPicture(
            [&](Material& material) {
                material.base_color = {0, 0, 0, 255};
                material.roughness = 0.4F;
                material.specular = specular;
                material.index_of_refraction = index;
            },
            {0.0, 0.0, -1.0});
        return meanOf(image, 38, 20, 58, 40);
    };
    EXPECT_LT(mirrored(0.0F, 1.5F), 2.0);
    EXPECT_GT(mirrored(1.0F, 1.5F), 1.3 * mirrored(0.4F, 1.5F));
    EXPECT_GT(mirrored(1.0F, 2.4F), 1.3 * mirrored(1.0F, 1.5F));
}

/// Balls of a colour, rougher from left to right, from plastic in front to metal behind.
SceneContent ballGrid(KM_Color color) {
    SceneContent content;
    for (int row = 0; row < 3; ++row)
        for (int column = 0; column < 6; ++column)
            addLook(content, sphereMesh({2.4 * column - 6.0, 2.4 * row, 1.0}, 1.0F, 48),
                    [&](Material& material) {
                        material.base_color = color;
                        material.metalness = 0.5F * static_cast<float>(row);
                        material.roughness = 0.2F * static_cast<float>(column);
                    });
    content.lights.push_back(sunLight({0.5, 0.7, -0.8}));
    return content;
}

TEST(Mirroring, BallsOfOtherRoughnessOrMetalnessLookDifferent) {
    std::vector<Image> pictures;
    for (const float metalness : {0.0F, 0.5F, 1.0F})
        for (const float roughness : {0.0F, 0.2F, 0.4F, 0.6F, 0.8F, 1.0F})
            pictures.push_back(ballPicture([&](Material& material) {
                material.base_color = {212, 160, 70, 255};
                material.metalness = metalness;
                material.roughness = roughness;
            }));
    for (std::size_t a = 0; a < pictures.size(); ++a)
        for (std::size_t b = 0; b < a; ++b) {
            int different = 0;
            for (int y = 0; y < size; ++y)
                for (int x = 0; x < size; ++x)
                    different += std::abs(brightness(pictures[a], x, y) -
                                          brightness(pictures[b], x, y)) > 4.0;
            EXPECT_GT(different, 100) << a << ' ' << b;
        }
}

TEST(Mirroring, WhatIsKeptOfTheSurroundingsIsFoundAgainWhenTheyChange) {
    DisplayPipeline pipeline;
    DisplayScene scene;
    const auto chrome = [](Material& material) {
        material.base_color = {250, 250, 250, 255};
        material.metalness = 1.0F;
        material.roughness = 0.5F;
    };
    SceneContent content = ball(chrome);
    content.lights.push_back(sunLight({0.5, 0.6, -0.6}));
    DisplayModeAttributes mode = modeNamed(L"Rendered");
    const auto expectAsFresh = [&] {
        Image image;
        ASSERT_TRUE(scene.update(content).ok());
        ASSERT_TRUE(pipeline.draw(scene, levelView(), mode, size, size, image).ok());
        EXPECT_EQ(image.rgba, drawn(content, levelView(), mode, size, size).rgba);
    };
    expectAsFresh();
    expectAsFresh();
    content.lights[0] = sunLight({0.9, 0.1, -0.1});
    expectAsFresh();
    mode.has_ground_plane = false;
    expectAsFresh();
    mode = modeNamed(L"Shaded");
    expectAsFresh();
    mode = modeNamed(L"Rendered");
    expectAsFresh();
}

TEST(Mirroring, AllProcessorsDrawTheSame) {
    const SceneContent content = ballGrid({212, 160, 70, 255});
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    const KM_Viewport view = perspectiveView({0.0, -16.0, 9.0}, {0.0, 2.0, 0.8});
    const auto picture = [&](const RayKernel& kernel) {
        DisplayPipeline pipeline(kernel);
        Image image;
        EXPECT_TRUE(pipeline.draw(scene, view, modeNamed(L"Rendered", 1), 301, 151, image).ok());
        return image.rgba;
    };
    EXPECT_EQ(picture(baseline_ray_kernel), picture(rayKernelInForce()));
    if (__builtin_cpu_supports("avx2")) {
        EXPECT_EQ(picture(baseline_ray_kernel), picture(avx2_ray_kernel));
    }
}

TEST(Mirroring, GridShowsNoBlackAndLittleWhite) {
    const KM_Viewport view = perspectiveView({0.0, -16.0, 9.0}, {0.0, 2.0, 0.8});
    const auto grid = [&](const char* name, KM_Color color) {
        const Image image = drawn(ballGrid(color), view, modeNamed(L"Rendered", 2), 1200, 600);
        show(image, name);
        return image;
    };
    grid("grid-red", {160, 20, 20, 255});
    grid("grid-black", {12, 12, 14, 255});
    grid("grid-grey", {200, 200, 205, 255});
    const Image image = grid("grid-gold", {212, 160, 70, 255});
    int white = 0;
    for (int y = 0; y < image.height; ++y)
        for (int x = 0; x < image.width; ++x) {
            ASSERT_GT(brightness(image, x, y), 8.0) << x << ' ' << y;
            white += brightness(image, x, y) > 250.0 ? 1 : 0;
        }
    EXPECT_LT(white, image.width * image.height / 100);
}

} // namespace
} // namespace quarn
