#include "tests/engine/display/LookScenes.h"

#include <gtest/gtest.h>
#include <tbb/global_control.h>

#include <cmath>

namespace quarn {
namespace {

constexpr int size = 200;
constexpr double half = 5.0;

/// Looks down at 45 degrees: up in the picture is (0, 1, 1) / sqrt 2.
KM_Viewport slopingView() {
    KM_Viewport view = perspectiveView({0.0, -50.0, 50.0}, {0.0, 0.0, 0.0});
    view.SetProjection(KM_parallel_view);
    view.SetFrustum(-half, half, -half, half, 1.0, 200.0);
    return view;
}

std::array<int, 3> seenAt(const Image& image, const KM_3dPoint& p) {
    const double up = (p.y + p.z) / std::sqrt(2.0);
    const auto pixel = image.pixel(static_cast<int>((p.x + half) / (2.0 * half) * size),
                                   static_cast<int>((half - up) / (2.0 * half) * size));
    return {pixel[0], pixel[1], pixel[2]};
}

/// A mirror on the floor and an unlit wall behind it, in four colours.
SceneContent wallBehindMirror(const std::function<void(Material&)>& floor) {
    SceneContent content;
    addLook(content, floorMesh(-4, -4, 4, 1, 0), floor);
    addLook(content, wallMesh(-4, 4, 1, 3), [](Material& material) {
        material.is_unlit = true;
        material.base_color = {255, 255, 255, 255};
        material.base_color_texture = textureOf(64, 64, [](int x, int y) {
            const std::uint8_t red = x < 32 ? 200 : 40;
            const std::uint8_t green = y < 32 ? 160 : 60;
            return std::array<std::uint8_t, 4>{red, green, 90, 255};
        });
    });
    content.lights.push_back(sunLight({0.3, 0.5, -0.8}));
    return content;
}

void makeMirror(Material& material) {
    material.base_color = {255, 255, 255, 255};
    material.metalness = 1.0F;
    material.roughness = 0.0F;
}

Image sloping(const SceneContent& content) {
    return drawn(content, slopingView(), modeNamed(L"Rendered"), size, size);
}

TEST(MirroredScene, MirrorShowsWhatStandsOppositeToThePixel) {
    const Image image = sloping(wallBehindMirror(makeMirror));
    show(image, "mirror");
    for (const double x : {-3.0, -1.0, -0.2, 0.2, 1.0, 3.0})
        for (const double z : {0.3, 1.2, 1.4, 1.6, 1.8, 2.7}) {
            const std::array<int, 3> wall = seenAt(image, {x, 1.0, z});
            const std::array<int, 3> mirrored = seenAt(image, {x, 1.0, -z});
            for (std::size_t c = 0; c < 3; ++c)
                EXPECT_NEAR(wall[c], mirrored[c], 4) << x << ' ' << z << ' ' << c;
        }
    EXPECT_NEAR(seenAt(image, {-1.0, 1.0, -2.0})[0], 200, 4);
    EXPECT_NEAR(seenAt(image, {1.0, 1.0, -1.0})[1], 60, 4);
}

TEST(MirroredScene, GlossShowsTheSceneFaintlyAndARoughMirrorNotAtAll) {
    const auto step = [](float metalness, float roughness) {
        const Image image = sloping(wallBehindMirror([&](Material& material) {
            material.base_color = {0, 0, 0, 255};
            material.metalness = metalness;
            material.roughness = roughness;
            if (metalness > 0.0F)
                material.base_color = {255, 255, 255, 255};
        }));
        return seenAt(image, {-0.3, 1.0, -1.0})[0] - seenAt(image, {0.3, 1.0, -1.0})[0];
    };
    EXPECT_GT(step(1.0F, 0.0F), 100);
    EXPECT_GT(step(0.0F, 0.0F), 10);
    EXPECT_LT(step(0.0F, 0.0F), 100);
    EXPECT_GT(step(1.0F, 0.3F), 20);
    EXPECT_LT(step(1.0F, 0.3F), step(1.0F, 0.1F) - 20);
    EXPECT_LT(std::abs(step(1.0F, 0.5F)), 3);
}

TEST(MirroredScene, MirrorsSeeTheGroundWithTheShadowsOnIt) {
    SceneContent content;
    // The mirror shows the ground 4 before it, where the board casts its shadow.
    addLook(content, wallMesh(-4, 4, 3, 3), makeMirror);
    const auto mirrored = [&](bool has_board) {
        SceneContent scene = content;
        if (has_board)
            addMesh(scene, floorMesh(-4, -3, 4, 1, 5), {90, 90, 90, 255});
        scene.lights.push_back(sunLight({0.0, 0.05, -1.0}));
        const Image image = drawn(scene, perspectiveView({0.0, -10.0, 6.0}, {0.0, 3.0, 1.5}),
                                  modeNamed(L"Rendered"), size, size);
        return brightness(image, size / 2, size / 2);
    };
    EXPECT_LT(mirrored(true), mirrored(false) - 40.0);
}

TEST(MirroredScene, HighlightsOnMetalVanishInTheShade) {
    const auto highlight = [](bool has_board) {
        SceneContent scene;
        addLook(scene, floorMesh(-4, -4, 4, 4, 0), [](Material& material) {
            makeMirror(material);
            material.base_color = {40, 40, 40, 255};
            material.roughness = 0.5F;
        });
        if (has_board) // it stands beside what is seen
            addMesh(scene, floorMesh(-2, 3, 2, 8, 5), {90, 90, 90, 255});
        scene.lights.push_back(sunLight({0.0, -1.0, -1.0}));
        return brightness(sloping(scene), size / 2, size / 2);
    };
    EXPECT_LT(highlight(true), highlight(false) - 30.0);
}

TEST(MirroredScene, WhatIsSeenThroughAPaneInAMirrorIsMixedWithThePane) {
    const auto mirrored = [](int opacity) {
        SceneContent content;
        addLook(content, floorMesh(-4, -4, 4, 1, 0), makeMirror);
        addLook(content, wallMesh(-4, 4, 1, 3), [&](Material& material) {
            material.base_color = {0, 0, 0, static_cast<std::uint8_t>(opacity)};
            material.see_through = true;
        });
        content.lights.push_back(sunLight({0.3, 0.5, -0.8}));
        return seenAt(sloping(content), {0.0, 1.0, -1.5})[2];
    };
    EXPECT_LT(mirrored(255), 10);
    EXPECT_GT(mirrored(128), mirrored(255) + 50);
    EXPECT_GT(mirrored(20), mirrored(128) + 20);
}

TEST(MirroredScene, IsTheSameForAnyNumberOfThreadsAndAllProcessors) {
    SceneContent content = wallBehindMirror(makeMirror);
    addLook(content, sphereMesh({0.0, -1.0, 1.0}, 1.0F, 24), [](Material& material) {
        material.metalness = 0.5F;
        material.roughness = 0.3F;
    });
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    const auto picture = [&](const RayKernel& kernel, std::size_t threads) {
        const tbb::global_control limit(tbb::global_control::max_allowed_parallelism, threads);
        DisplayPipeline pipeline(kernel);
        Image image;
        EXPECT_TRUE(
            pipeline.draw(scene, slopingView(), modeNamed(L"Rendered", 2), 211, 187, image).ok());
        return image.rgba;
    };
    const auto expected = picture(baseline_ray_kernel, 1);
    EXPECT_EQ(expected, picture(baseline_ray_kernel, 4));
    EXPECT_EQ(expected, picture(rayKernelInForce(), 4));
    if (__builtin_cpu_supports("avx2")) {
        EXPECT_EQ(expected, picture(avx2_ray_kernel, 3));
    }
}

} // namespace
} // namespace quarn
