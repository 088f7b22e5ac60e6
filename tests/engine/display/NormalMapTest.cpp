#include "tests/engine/display/LookScenes.h"

#include <gtest/gtest.h>

#include <cmath>

namespace quarn {
namespace {

constexpr int size = 60;
const KM_3dVector sun_shines_to{0.4, 0.8, -0.5};

using Texel = std::array<std::uint8_t, 4>;

/// A map of one direction.
std::shared_ptr<const Texture> oneNormal(double x, double y, double z) {
    const auto byte = [](double number) {
        return static_cast<std::uint8_t>(std::lround(127.5 * (number + 1.0)));
    };
    const Texel texel{byte(x), byte(y), byte(z), 255};
    return textureOf(2, 2, [&](int, int) { return texel; });
}

void makeSatin(Material& material) {
    material.base_color = {180, 90, 60, 255};
    material.metalness = 0.4F;
    material.roughness = 0.6F;
}

/// What the middle of a wall at y = 0 looks like, seen from along y.
std::array<int, 3> middleOf(SceneContent content, double eye_y = -30.0,
                            const wchar_t* mode = L"Rendered") {
    content.lights.push_back(sunLight(sun_shines_to));
    KM_Viewport view = perspectiveView({0.0, eye_y, 2.0}, {0.0, 0.0, 2.0});
    view.SetProjection(KM_parallel_view);
    view.SetFrustum(-1.0, 1.0, -1.0, 1.0, 1.0, 100.0);
    const Image image = drawn(content, view, modeNamed(mode), size, size);
    const auto pixel = image.pixel(size / 2, size / 2);
    return {pixel[0], pixel[1], pixel[2]};
}

SceneContent mappedWall(
    const std::shared_ptr<const Texture>& normals, KM_Mesh wall,
    const std::function<void(Material&)>& change = [](Material&) {}) {
    SceneContent content;
    addLook(content, std::move(wall), [&](Material& material) {
        makeSatin(material);
        material.normals.texture = normals;
        change(material);
    });
    return content;
}

KM_Mesh plainWall() {
    return wallMesh(-2, 2, 0, 4);
}

/// The wall turned about its middle, first about x, which lifts its face up, then about z.
SceneContent tiltedWall(double up, double aside) {
    KM_Mesh wall = plainWall();
    const KM_3dPoint middle(0.0, 0.0, 2.0);
    wall.Transform(KM_Xform::Rotation(aside, KM_3dVector::ZAxis, middle) *
                   KM_Xform::Rotation(-up, KM_3dVector::XAxis, middle));
    SceneContent content;
    addLook(content, std::move(wall), makeSatin);
    return content;
}

void expectAlike(const std::array<int, 3>& a, const std::array<int, 3>& b, int tolerance = 2) {
    for (std::size_t c = 0; c < 3; ++c)
        EXPECT_NEAR(a[c], b[c], tolerance) << c;
}

TEST(NormalMap, OfATiltedPlaneShadesLikeTheTiltedPlane) {
    constexpr double tilt = 0.35;
    const std::array<int, 3> flat = middleOf(tiltedWall(0.0, 0.0));
    const std::array<int, 3> up =
        middleOf(mappedWall(oneNormal(0.0, std::sin(tilt), std::cos(tilt)), plainWall()));
    expectAlike(up, middleOf(tiltedWall(tilt, 0.0)));
    EXPECT_GT(std::abs(up[0] - flat[0]), 6);
    const std::array<int, 3> aside =
        middleOf(mappedWall(oneNormal(std::sin(tilt), 0.0, std::cos(tilt)), plainWall()));
    expectAlike(aside, middleOf(tiltedWall(0.0, tilt)));
    EXPECT_GT(std::abs(aside[0] - flat[0]), 6);
    EXPECT_GT(std::abs(aside[0] - up[0]), 6);
}

TEST(NormalMap, ShowsInShadedToo) {
    const std::array<int, 3> flat =
        middleOf(mappedWall(oneNormal(0.0, 0.0, 1.0), plainWall()), -30.0, L"Shaded");
    const std::array<int, 3> up =
        middleOf(mappedWall(oneNormal(0.0, -0.5, 0.8), plainWall()), -30.0, L"Shaded");
    EXPECT_LT(up[0], flat[0] - 10);
}

TEST(NormalMap, GoesByTheWayTheTextureLiesOnTheMesh) {
    const auto right = oneNormal(0.4, 0.0, 0.9);
    const auto left = oneNormal(-0.4, 0.0, 0.9);
    const auto upward = oneNormal(0.0, 0.4, 0.9);
    KM_Mesh mirrored = plainWall();
    KM_Mesh turned = plainWall();
    for (std::size_t i = 0; i < 4; ++i) {
        const KM_2fPoint t = mirrored.m_T[i];
        mirrored.m_T[i] = {1.0F - t.x, t.y};
        turned.m_T[i] = {t.y, 1.0F - t.x}; // its u grows upward, its v to the left
    }
    expectAlike(middleOf(mappedWall(right, mirrored)), middleOf(mappedWall(left, plainWall())));
    expectAlike(middleOf(mappedWall(right, turned)), middleOf(mappedWall(upward, plainWall())));
}

TEST(NormalMap, GoesByTheTransformOfTheTextureToo) {
    const std::array<int, 3> turned =
        middleOf(mappedWall(oneNormal(0.4, 0.0, 0.9), plainWall(), [](Material& material) {
            material.normals.u = {0, 1, 0};
            material.normals.v = {-1, 0, 1};
        }));
    expectAlike(turned, middleOf(mappedWall(oneNormal(0.0, 0.4, 0.9), plainWall())));
}

TEST(NormalMap, IsTurnedWithAPlacedMeshAndMirroredWithAMirroredOne) {
    const auto map = oneNormal(0.35, 0.3, 0.85);
    const KM_3dPoint middle(0.0, 0.0, 2.0);
    KM_Xform mirrored;
    mirrored.m_xform[0][0] = -1.0;
    for (const KM_Xform& place : {KM_Xform::Rotation(0.5, KM_3dVector::ZAxis, middle),
                                  KM_Xform::Rotation(0.5, KM_3dVector::YAxis, middle) * mirrored}) {
        KM_Mesh moved = plainWall();
        moved.Transform(place);
        SceneContent placed = mappedWall(map, plainWall());
        placed.meshes[0].placed.world_from_mesh = place;
        expectAlike(middleOf(placed), middleOf(mappedWall(map, moved)), 1);
    }
}

TEST(NormalMap, BumpSeenFromBehindIsADent) {
    const auto right = oneNormal(0.4, 0.0, 0.9);
    KM_Mesh other_side = plainWall();
    for (KM_MeshTriangle& triangle : other_side.m_F)
        std::swap(triangle.vi[1], triangle.vi[2]);
    // Its front looks away now, so that its normal leans as that of the first does, seen from
    // behind.
    expectAlike(middleOf(mappedWall(right, other_side)),
                middleOf(mappedWall(oneNormal(-0.4, 0.0, 0.9), plainWall())));
}

TEST(NormalMap, ScaleMakesTheReliefFlatterAndDeeper) {
    const auto scaled = [](float scale) {
        return middleOf(mappedWall(oneNormal(0.0, 0.4, 0.9), plainWall(),
                                   [&](Material& material) { material.normal_scale = scale; }));
    };
    expectAlike(scaled(0.0F), middleOf(tiltedWall(0.0, 0.0)), 1);
    expectAlike(scaled(0.5F), middleOf(mappedWall(oneNormal(0.0, 0.2, 0.9), plainWall())), 2);
}

TEST(NormalMap, TexelWithoutLengthLeavesTheNormal) {
    expectAlike(middleOf(mappedWall(oneNormal(0.0, 0.0, 0.0), plainWall())),
                middleOf(tiltedWall(0.0, 0.0)), 1);
}

TEST(NormalMap, WithoutCoordinatesOrOnATextureThatIsALineLeavesTheNormal) {
    KM_Mesh without = plainWall();
    without.m_T.clear();
    KM_Mesh line = plainWall();
    for (KM_2fPoint& t : line.m_T)
        t = {0.25F, 0.25F};
    const std::array<int, 3> flat = middleOf(tiltedWall(0.0, 0.0));
    expectAlike(middleOf(mappedWall(oneNormal(0.4, 0.0, 0.9), without)), flat, 0);
    expectAlike(middleOf(mappedWall(oneNormal(0.4, 0.0, 0.9), line)), flat, 0);
}

TEST(Occlusion, KeepsTheLightOfTheSkyFromASurfaceButNotThatOfTheSun) {
    const auto wall = [](int red, float strength, const KM_3dVector& shines_to) {
        SceneContent content;
        addLook(content, plainWall(), [&](Material& material) {
            material.occlusion.texture = textureOf(2, 2, [&](int, int) {
                return Texel{static_cast<std::uint8_t>(red), 255, 255, 255};
            });
            material.occlusion_strength = strength;
        });
        content.lights.push_back(sunLight(shines_to));
        KM_Viewport view = perspectiveView({0.0, -30.0, 2.0}, {0.0, 0.0, 2.0});
        const Image image = drawn(content, view, modeNamed(L"Rendered"), size, size);
        return brightness(image, size / 2, size / 2);
    };
    const KM_3dVector from_behind{0.0, -1.0, -0.5};
    EXPECT_LT(wall(0, 1.0F, from_behind), 0.5 * wall(255, 1.0F, from_behind));
    EXPECT_GT(wall(0, 1.0F, sun_shines_to), 0.6 * wall(255, 1.0F, sun_shines_to));
    EXPECT_GT(wall(0, 0.5F, from_behind), wall(0, 1.0F, from_behind) + 20.0);
    EXPECT_EQ(wall(0, 0.0F, from_behind), wall(255, 1.0F, from_behind));
}

constexpr int bricks = 256;

/// How far a place of a brick wall stands out; joints lie 1 deep, with a rounded border.
double reliefOf(int x, int y) {
    const int course = y / 32;
    const int along = (x + (course % 2) * 32) % 64;
    const int up = y % 32;
    const double border = std::min({along, 63 - along, up, 31 - up}) / 4.0;
    const double grain = 0.12 * std::sin(0.9 * x) * std::cos(1.3 * y + 0.4 * course);
    return std::min(1.0, std::max(0.0, border - 0.4)) + grain;
}

Texel brickNormal(int x, int y) {
    const auto at = [](int i, int j) {
        return reliefOf((i + bricks) % bricks, (j + bricks) % bricks);
    };
    const double dx = at(x - 1, y) - at(x + 1, y);
    const double dy = at(x, y + 1) - at(x, y - 1); // rows run down
    const double scale = 127.5 / std::sqrt(dx * dx + dy * dy + 1.0);
    const auto byte = [&](double n) {
        return static_cast<std::uint8_t>(std::lround(127.5 + scale * n));
    };
    return {byte(dx), byte(dy), byte(1.0), 255};
}

Texel brickColor(int x, int y) {
    const bool is_joint = reliefOf(x, y) < 0.5;
    const int brick = (x + (y / 32) % 2 * 32) % bricks / 64;
    const int shade = ((brick + y / 32 * 3) * 37) % 40;
    if (is_joint)
        return {176, 170, 160, 255};
    return {static_cast<std::uint8_t>(150 + shade), static_cast<std::uint8_t>(72 + shade / 2), 54,
            255};
}

TEST(NormalMap, GivesABrickWallItsRelief) {
    const auto wall = [](bool has_map) {
        SceneContent content;
        KM_Mesh mesh = wallMesh(-4, 4, 0, 4);
        for (KM_2fPoint& t : mesh.m_T)
            t = {4.0F * t.x, 2.0F * t.y};
        addLook(content, std::move(mesh), [&](Material& material) {
            material.base_color = {255, 255, 255, 255};
            material.base_color_texture = textureOf(bricks, bricks, brickColor);
            material.roughness = 0.85F;
            if (has_map)
                material.normals.texture = textureOf(bricks, bricks, brickNormal);
        });
        content.lights.push_back(sunLight({0.9, 0.35, -0.6}));
        return drawn(content, perspectiveView({1.5, -5.0, 1.8}, {0.0, 0.0, 2.0}),
                     modeNamed(L"Rendered", 2), 800, 500);
    };
    const Image flat = wall(false);
    const Image relief = wall(true);
    show(flat, "bricks-flat");
    show(relief, "bricks-relief");
    double difference = 0.0;
    for (int y = 150; y < 350; ++y)
        for (int x = 250; x < 550; ++x)
            difference += std::abs(brightness(flat, x, y) - brightness(relief, x, y));
    EXPECT_GT(difference / (200.0 * 300.0), 4.0);
}

} // namespace
} // namespace quarn
