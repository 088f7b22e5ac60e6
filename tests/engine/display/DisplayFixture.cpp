#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

namespace quarn {

std::shared_ptr<const KM_Mesh> shared(KM_Mesh mesh) {
    auto result = std::make_shared<KM_Mesh>(std::move(mesh));
    result->PadForRayTracing();
    return result;
}

KM_Mesh floorMesh(float x0, float y0, float x1, float y1, float z) {
    KM_Mesh mesh;
    mesh.m_V = {{x0, y0, z}, {x1, y0, z}, {x1, y1, z}, {x0, y1, z}};
    mesh.m_F = {{{0, 1, 2}}, {{0, 2, 3}}};
    return mesh;
}

KM_Mesh boxMesh(const KM_3dPoint& min, const KM_3dPoint& max) {
    KM_Mesh mesh;
    const KM_BoundingBox box(min, max);
    for (int i = 0; i < 8; ++i)
        mesh.m_V.emplace_back(box.Corner(i));
    mesh.m_F = {{{0, 2, 3}}, {{0, 3, 1}}, {{4, 5, 7}}, {{4, 7, 6}}, {{0, 1, 5}}, {{0, 5, 4}},
                {{2, 6, 7}}, {{2, 7, 3}}, {{0, 4, 6}}, {{0, 6, 2}}, {{1, 3, 7}}, {{1, 7, 5}}};
    return mesh;
}

KM_Mesh sphereMesh(const KM_3dPoint& center, float radius, int rings) {
    KM_Mesh mesh;
    const int segments = 2 * rings;
    for (int j = 0; j <= rings; ++j)
        for (int i = 0; i < segments; ++i) {
            const double polar = KM_PI * j / rings;
            const double around = 2.0 * KM_PI * i / segments;
            const KM_3dVector n(std::sin(polar) * std::cos(around),
                                std::sin(polar) * std::sin(around), std::cos(polar));
            mesh.m_N.emplace_back(n);
            mesh.m_V.emplace_back(center + double{radius} * n);
        }
    for (int j = 0; j < rings; ++j)
        for (int i = 0; i < segments; ++i) {
            const auto at = [segments](int ring, int segment) {
                return static_cast<std::uint32_t>(ring * segments + segment % segments);
            };
            if (j > 0)
                mesh.m_F.push_back({{at(j, i), at(j + 1, i), at(j, i + 1)}});
            if (j + 1 < rings)
                mesh.m_F.push_back({{at(j, i + 1), at(j + 1, i), at(j + 1, i + 1)}});
        }
    return mesh;
}

KM_Mesh hillMesh(int cells) {
    KM_Mesh mesh;
    const auto side = static_cast<std::uint32_t>(cells + 1);
    for (int j = 0; j <= cells; ++j)
        for (int i = 0; i <= cells; ++i) {
            const float x = 100.0F * static_cast<float>(i) / static_cast<float>(cells) - 50.0F;
            const float y = 100.0F * static_cast<float>(j) / static_cast<float>(cells) - 50.0F;
            mesh.m_V.emplace_back(x, y, 4.0F * std::sin(0.2F * x) * std::cos(0.17F * y));
        }
    for (std::uint32_t j = 0; j + 1 < side; ++j)
        for (std::uint32_t i = 0; i + 1 < side; ++i) {
            const std::uint32_t a = j * side + i;
            mesh.m_F.push_back({{a, a + 1, a + side + 1}});
            mesh.m_F.push_back({{a, a + side + 1, a + side}});
        }
    mesh.ComputeVertexNormals();
    return mesh;
}

std::size_t addMesh(SceneContent& content, KM_Mesh mesh, KM_Color color) {
    auto material = std::make_shared<Material>();
    material->base_color = color;
    content.meshes.push_back({{shared(std::move(mesh)), material, {}}, KM_CreateUuid()});
    ++content.revision;
    return content.meshes.size() - 1;
}

KM_Light sunLight(const KM_3dVector& shines_to) {
    KM_Light light;
    light.SetStyle(KM_LightStyle::world_directional);
    light.SetDirection(shines_to);
    return light;
}

KM_Viewport topView(double half) {
    KM_Viewport viewport;
    viewport.SetCameraLocation({0.0, 0.0, 100.0});
    viewport.SetCameraDirection({0.0, 0.0, -1.0});
    viewport.SetCameraUp({0.0, 1.0, 0.0});
    viewport.SetProjection(KM_parallel_view);
    viewport.SetFrustum(-half, half, -half, half, 1.0, 1000.0);
    return viewport;
}

KM_Viewport perspectiveView(const KM_3dPoint& eye, const KM_3dPoint& target) {
    KM_Viewport viewport;
    viewport.SetCameraLocation(eye);
    viewport.SetCameraDirection(target - eye);
    viewport.SetCameraUp(KM_3dVector::ZAxis);
    viewport.SetTargetPoint(target);
    return viewport;
}

DisplayModeAttributes modeNamed(const wchar_t* english_name, int antialiasing_level) {
    for (const DisplayModeAttributes& candidate : standardDisplayModes())
        if (candidate.english_name == english_name) {
            DisplayModeAttributes mode = candidate;
            mode.antialiasing_level = antialiasing_level;
            return mode;
        }
    ADD_FAILURE() << "no such display mode";
    return {};
}

Image drawn(const SceneContent& content, const KM_Viewport& viewport,
            const DisplayModeAttributes& mode, int width, int height, DepthImage* depth) {
    DisplayScene scene;
    const Result<void> updated = scene.update(content);
    EXPECT_TRUE(updated.ok()) << updated.message();
    DisplayPipeline pipeline;
    Image image;
    const Result<void> result = pipeline.draw(scene, viewport, mode, width, height, image, depth);
    EXPECT_TRUE(result.ok()) << result.message();
    return image;
}

double brightness(const Image& image, int x, int y) {
    const auto pixel = image.pixel(x, y);
    return (double{1.0} * pixel[0] + pixel[1] + pixel[2]) / 3.0;
}

double meanBrightness(const Image& image) {
    double sum = 0.0;
    for (int y = 0; y < image.height; ++y)
        for (int x = 0; x < image.width; ++x)
            sum += brightness(image, x, y);
    return sum / (double{1.0} * image.width * image.height);
}

bool samePixel(const Image& a, int ax, int ay, const Image& b, int bx, int by) {
    const auto first = a.pixel(ax, ay);
    const auto second = b.pixel(bx, by);
    return std::equal(first.begin(), first.end(), second.begin());
}

} // namespace quarn
