#include "tests/engine/display/DisplayFixture.h"

#include "engine/images/ColorSpace.h"

#include <gtest/gtest.h>

#include <cmath>

namespace quarn {
namespace {

constexpr int width = 320;
constexpr int height = 200;

std::shared_ptr<const Texture> checker() {
    auto texture = std::make_shared<Texture>();
    texture->width = texture->height = 64;
    for (int y = 0; y < 64; ++y)
        for (int x = 0; x < 64; ++x) {
            const std::uint8_t value = ((x / 8 + y / 8) % 2 != 0) ? 255 : 0;
            texture->rgba.insert(texture->rgba.end(), {value, value, value, 255});
        }
    return texture;
}

/// A floor to the horizon with a checkered texture that repeats every four units.
SceneContent checkeredFloor() {
    SceneContent content;
    constexpr int strips = 40;
    KM_Mesh mesh;
    for (std::uint32_t i = 0; i < strips; ++i) {
        const KM_Mesh strip = floorMesh(-400.0F, 20.0F * static_cast<float>(i), 400.0F,
                                        20.0F * static_cast<float>(i + 1), 0.0F);
        for (const KM_3fPoint& p : strip.m_V) {
            mesh.m_V.push_back(p);
            mesh.m_T.emplace_back(p.x / 4.0F, p.y / 4.0F);
        }
        for (const KM_MeshTriangle& t : strip.m_F)
            mesh.m_F.push_back({{t.vi[0] + 4 * i, t.vi[1] + 4 * i, t.vi[2] + 4 * i}});
    }
    addMesh(content, std::move(mesh));
    auto material = std::make_shared<Material>();
    material->base_color = {255, 255, 255, 255};
    material->base_color_texture = checker();
    content.meshes.back().placed.material = material;
    return content;
}

/// The floor seen from a man's height, the camera `forward` units along.
Image walked(DisplayScene& scene, double forward, int level) {
    DisplayPipeline pipeline;
    Image image;
    DisplayModeAttributes mode = modeNamed(L"Rendered", level);
    const KM_Viewport view = perspectiveView({0.3, 5.0 + forward, 1.7}, {0.3, 25.0 + forward, 0.0});
    EXPECT_TRUE(pipeline.draw(scene, view, mode, width, height, image).ok());
    return image;
}

/// The mean step of a pixel of some rows from one picture to the next, 0 to 255.
double meanStep(const Image& a, const Image& b, int first_row, int last_row) {
    double sum = 0.0;
    for (int y = first_row; y <= last_row; ++y)
        for (int x = 0; x < width; ++x)
            sum += std::abs(brightness(a, x, y) - brightness(b, x, y));
    return sum / (double{width} * (last_row - first_row + 1));
}

/// Mean brightness of a row.
double meanOfRow(const Image& image, int y) {
    double sum = 0.0;
    for (int x = 0; x < width; ++x)
        sum += brightness(image, x, y);
    return sum / width;
}

int horizonRow(const KM_Viewport& view) {
    double bottom = 0.0;
    double top = 0.0;
    double near_distance = 0.0;
    KM_Viewport fitted = view;
    fitted.SetFrustumAspect(double{width} / height);
    fitted.GetFrustum(nullptr, nullptr, &bottom, &top, &near_distance, nullptr);
    const double slope = std::tan(std::asin(1.7 / std::hypot(20.0, 1.7)));
    return static_cast<int>((top - slope * near_distance) / (top - bottom) * height);
}

TEST(TextureDrawing, FarCheckersAreTheMeanOfTheirColours) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(checkeredFloor()).ok());
    SceneContent gray = checkeredFloor();
    auto material = std::make_shared<Material>();
    // Half of the light of white, in sRGB.
    const std::uint8_t half = srgbByteFromLinear(0.5F);
    material->base_color = {half, half, half, 255};
    gray.meshes[0].placed.material = material;
    DisplayScene gray_scene;
    ASSERT_TRUE(gray_scene.update(gray).ok());
    const KM_Viewport view = perspectiveView({0.3, 5.0, 1.7}, {0.3, 25.0, 0.0});
    const int row = horizonRow(view) + 4;
    const Image checkers = walked(scene, 0.0, 2);
    const Image mean = walked(gray_scene, 0.0, 2);
    EXPECT_NEAR(meanOfRow(checkers, row), meanOfRow(mean, row), 4.0);
    for (int x = 0; x < width; ++x)
        EXPECT_NEAR(brightness(checkers, x, row), brightness(mean, x, row), 12.0) << x;
}

TEST(TextureDrawing, CheckersToTheHorizonDoNotShimmerWhileTheCameraWalks) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(checkeredFloor()).ok());
    const KM_Viewport view = perspectiveView({0.3, 5.0, 1.7}, {0.3, 25.0, 0.0});
    const int horizon = horizonRow(view);
    for (const int level : {0, 2}) {
        double far_step = 0.0;
        double middle_step = 0.0;
        constexpr int steps = 8;
        Image before = walked(scene, 0.0, level);
        for (int i = 1; i <= steps; ++i) {
            const Image now = walked(scene, 0.02 * i, level);
            far_step += meanStep(before, now, horizon + 2, horizon + 12) / steps;
            middle_step += meanStep(before, now, horizon + 13, horizon + 40) / steps;
            before = now;
        }
        EXPECT_LT(far_step, 0.25) << level;
        // Here single squares are seen to move.
        EXPECT_LT(middle_step, level == 0 ? 6.0 : 3.0) << level;
    }
}

} // namespace
} // namespace quarn
