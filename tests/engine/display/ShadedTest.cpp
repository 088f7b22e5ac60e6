#include "tests/engine/display/LookScenes.h"

#include <gtest/gtest.h>
#include <tbb/global_control.h>

#include <algorithm>
#include <cmath>

namespace quarn {
namespace {

constexpr int size = 100;

/// Seen from a little above, as a model is looked at.
KM_Viewport usualView() {
    return perspectiveView({5.0, -11.0, 5.0}, {0.0, 0.0, 1.0});
}

Image shaded(const SceneContent& content) {
    return drawn(content, usualView(), modeNamed(L"Shaded"), size, size);
}

std::shared_ptr<const Texture> redAndBlue() {
    return textureOf(2, 1, [](int x, int) {
        return x == 0 ? std::array<std::uint8_t, 4>{220, 30, 30, 255}
                      : std::array<std::uint8_t, 4>{30, 30, 220, 255};
    });
}

TEST(Shaded, ShowsTextures) {
    SceneContent content;
    addLook(content, wallMesh(-4, 4, 0, 4), [](Material& material) {
        material.base_color = {255, 255, 255, 255};
        material.base_color_texture = redAndBlue();
    });
    const Image image =
        drawn(content, perspectiveView({0, -9, 2}, {0, 0, 2}), modeNamed(L"Shaded"), size, size);
    show(image, "shaded-texture");
    const auto left = image.pixel(5, 50);
    const auto right = image.pixel(95, 50);
    EXPECT_GT(left[0], left[2] + 80);
    EXPECT_GT(right[2], right[0] + 80);
}

TEST(Shaded, ShowsVertexColours) {
    SceneContent content;
    KM_Mesh mesh = wallMesh(-4, 4, 0, 4);
    mesh.m_C = {{220, 30, 30, 255}, {30, 30, 220, 255}, {30, 30, 220, 255}, {220, 30, 30, 255}};
    addMesh(content, std::move(mesh), {255, 255, 255, 255});
    const Image image =
        drawn(content, perspectiveView({0, -9, 2}, {0, 0, 2}), modeNamed(L"Shaded"), size, size);
    EXPECT_GT(image.pixel(5, 50)[0], image.pixel(5, 50)[2] + 60);
    EXPECT_GT(image.pixel(95, 50)[2], image.pixel(95, 50)[0] + 60);
}

/// The object that each pixel shows, by a picture without it.
std::vector<bool> pixelsOf(const SceneContent& content) {
    DepthImage depth;
    drawn(content, usualView(), modeNamed(L"Shaded"), size, size, &depth);
    std::vector<bool> shown;
    for (const float nearness : depth.nearness)
        shown.push_back(nearness > 0.0F);
    return shown;
}

/// Steps of brightness over the borders of what is drawn, without the lowest tenth.
double contrastAlongBorder(const SceneContent& content, const Image& image) {
    const std::vector<bool> shown = pixelsOf(content);
    std::vector<double> steps;
    for (int y = 2; y + 2 < size; ++y)
        for (int x = 2; x + 2 < size; ++x) {
            const auto at = static_cast<std::size_t>(y * size + x);
            if (shown[at] && !shown[at - 1])
                steps.push_back(
                    std::abs(brightness(image, x + 1, y) - brightness(image, x - 2, y)));
            if (shown[at] && !shown[at + 1])
                steps.push_back(
                    std::abs(brightness(image, x - 1, y) - brightness(image, x + 2, y)));
        }
    std::ranges::sort(steps);
    return steps[steps.size() / 10];
}

TEST(Shaded, WhiteAndBlackModelsStandOutFromGroundAndBackdrop) {
    for (const std::uint8_t value : {255, 12}) {
        const KM_Color color{value, value, value, 255};
        SceneContent ball;
        addMesh(ball, sphereMesh({0.0, 0.0, 2.0}, 2.0F, 48), color);
        EXPECT_GT(contrastAlongBorder(ball, shaded(ball)), 12.0) << int{value};
        SceneContent box;
        addMesh(box, boxMesh({-2.0, -2.0, 0.0}, {2.0, 2.0, 3.0}), color);
        EXPECT_GT(contrastAlongBorder(box, shaded(box)), 12.0) << int{value};
    }
}

TEST(Shaded, FacesOfAWhiteBoxDiffer) {
    SceneContent content;
    addMesh(content, boxMesh({-2.0, -2.0, 0.0}, {2.0, 2.0, 3.0}), {255, 255, 255, 255});
    const Image image = shaded(content);
    show(image, "shaded-box");
    const double top = brightness(image, 45, 17);
    const double left = brightness(image, 35, 50);
    const double right = brightness(image, 82, 50);
    EXPECT_GT(std::abs(top - left), 8.0);
    EXPECT_GT(std::abs(left - right), 8.0);
    EXPECT_GT(std::abs(top - right), 8.0);
    EXPECT_LT(std::max({top, left, right}), 253.0);
}

TEST(Shaded, GroundRunsIntoTheBackdropWithoutABorder) {
    SceneContent content;
    addMesh(content, boxMesh({-0.3, -0.3, 0.0}, {0.3, 0.3, 0.5}));
    const Image image =
        drawn(content, perspectiveView({0, -4, 1}, {0, 0, 0.4}), modeNamed(L"Shaded"), size, 200);
    for (int y = 1; y < 200; ++y)
        EXPECT_NEAR(brightness(image, 5, y), brightness(image, 5, y - 1), 4.0) << y;
}

TEST(Shaded, ModelsDarkenTheGroundWhereTheyStand) {
    SceneContent content;
    addMesh(content, sphereMesh({0.0, 0.0, 1.0}, 1.0F, 48), {255, 255, 255, 255});
    const auto view = perspectiveView({0, -12, 3}, {0, 0, 0.5});
    const Image image = drawn(content, view, modeNamed(L"Shaded"), size, size);
    DisplayModeAttributes without = modeNamed(L"Shaded");
    without.has_ground_plane = false;
    const Image backdrop = drawn(content, view, without, size, size);
    int darker = 0;
    for (int y = 0; y < size; ++y)
        for (int x = 0; x < size; ++x) {
            EXPECT_LE(brightness(image, x, y), brightness(backdrop, x, y) + 1.0);
            darker += brightness(image, x, y) < brightness(backdrop, x, y) - 10.0 ? 1 : 0;
        }
    EXPECT_GT(darker, 50);
    EXPECT_LT(darker, size * size / 8);
}

TEST(Shaded, MetalShowsTheStudioAndNoNeighbours) {
    const auto ball = [](float metalness, float roughness, bool has_neighbour) {
        SceneContent content;
        addLook(content, sphereMesh({0.0, 0.0, 2.0}, 2.0F, 48), [&](Material& material) {
            material.base_color = {230, 190, 110, 255};
            material.metalness = metalness;
            material.roughness = roughness;
        });
        const std::size_t neighbour =
            addMesh(content, boxMesh({2.1, -2.0, 0.0}, {4.0, 2.0, 4.0}), {220, 0, 0, 255});
        if (!has_neighbour)
            content.meshes[neighbour].placed.material = content.meshes[0].placed.material;
        return drawn(content, perspectiveView({0, -11, 2}, {0, 0, 2}), modeNamed(L"Shaded"), size,
                     size);
    };
    const auto differing = [](const Image& a, const Image& b) {
        int count = 0;
        for (int y = 30; y < 70; ++y)
            for (int x = 35; x < 60; ++x)
                count += std::abs(brightness(a, x, y) - brightness(b, x, y)) > 4.0 ? 1 : 0;
        return count;
    };
    const Image smooth = ball(1.0F, 0.1F, true);
    EXPECT_GT(differing(smooth, ball(1.0F, 0.7F, true)), 300);
    EXPECT_GT(differing(smooth, ball(0.0F, 1.0F, true)), 300);
    EXPECT_EQ(differing(smooth, ball(1.0F, 0.1F, false)), 0);
}

/// White, textured, black, metal and glass.
SceneContent shelf() {
    SceneContent content;
    addMesh(content, boxMesh({-6.0, -1.0, 0.0}, {-4.2, 1.0, 2.4}), {255, 255, 255, 255});
    addMesh(content, sphereMesh({-2.8, 0.0, 1.1}, 1.1F, 48), {255, 255, 255, 255});
    addMesh(content, sphereMesh({-0.3, 0.0, 1.1}, 1.1F, 48), {14, 14, 16, 255});
    KM_Mesh board = wallMesh(-1.4, 1.0, 2.2, 3.4);
    addLook(content, std::move(board), [](Material& material) {
        material.base_color = {255, 255, 255, 255};
        material.base_color_texture = redAndBlue();
    });
    const auto addBall = [&](double x, const std::function<void(Material&)>& change) {
        addLook(content, sphereMesh({x, 0.0, 1.1}, 1.1F, 48), change);
    };
    addBall(2.2, [](Material& material) {
        material.base_color = {255, 215, 130, 255};
        material.metalness = 1.0F;
        material.roughness = 0.25F;
    });
    addBall(4.7, [](Material& material) {
        material.base_color = {255, 255, 255, 255};
        material.roughness = 0.0F;
        material.transmission = 1.0F;
    });
    addBall(7.2, [](Material& material) {
        material.base_color = {150, 20, 24, 255};
        material.roughness = 0.3F;
    });
    return content;
}

TEST(Shaded, IsTheSameForAnyNumberOfThreadsAndAllProcessors) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(shelf()).ok());
    const KM_Viewport view = perspectiveView({2.0, -15.0, 5.0}, {0.8, 0.0, 1.0});
    const auto picture = [&](const RayKernel& kernel, std::size_t threads) {
        const tbb::global_control limit(tbb::global_control::max_allowed_parallelism, threads);
        DisplayPipeline pipeline(kernel);
        Image image;
        EXPECT_TRUE(pipeline.draw(scene, view, modeNamed(L"Shaded", 2), 303, 151, image).ok());
        return image.rgba;
    };
    const auto expected = picture(baseline_ray_kernel, 1);
    EXPECT_EQ(expected, picture(baseline_ray_kernel, 4));
    EXPECT_EQ(expected, picture(rayKernelInForce(), 4));
    const Image image = drawn(shelf(), view, modeNamed(L"Shaded", 2), 1200, 600);
    show(image, "shaded-shelf");
    const Image rendered = drawn(shelf(), view, modeNamed(L"Rendered", 2), 1200, 600);
    show(rendered, "rendered-shelf");
}

} // namespace
} // namespace quarn
