#include "tests/engine/display/LookScenes.h"
#include "tests/engine/render/RenderFixture.h"

#include <cmath>
#include <numbers>

namespace quarn {
namespace {

constexpr int side = 32;
constexpr int samples = 256;

/// A sphere in the middle of what topView(8) shows, and the mean light of its inner part.
double lightOfSphere(const std::function<void(Material&)>& change) {
    SceneContent content;
    addLook(content, sphereMesh(KM_3dPoint::Origin, 5.0F, 64), change);
    const RenderLayers layers = inEvenLight(content, topView(8.0), side, samples);
    double sum = 0.0;
    int count = 0;
    for (int y = 8; y < 24; ++y)
        for (int x = 8; x < 24; ++x, ++count)
            sum += lightAt(layers, 1, x, y);
    return sum / count;
}

TEST(Paths, WhiteSurfacesOfEveryRoughnessVanishInEvenLight) {
    for (const float metalness : {0.0F, 0.5F, 1.0F})
        for (const float roughness : {0.0F, 0.15F, 0.4F, 0.7F, 1.0F})
            EXPECT_NEAR(lightOfSphere([&](Material& material) {
                            material.base_color = {255, 255, 255, 255};
                            material.metalness = metalness;
                            material.roughness = roughness;
                        }),
                        1.0, 0.01)
                << metalness << ' ' << roughness;
}

TEST(Paths, NoMaterialSendsMoreLightThanItGets) {
    const auto white = [](Material& material) {
        material.base_color = {255, 255, 255, 255};
        material.roughness = 0.3F;
    };
    EXPECT_LE(lightOfSphere([&](Material& m) { white(m), m.clearcoat = 1.0F; }), 1.01);
    EXPECT_LE(lightOfSphere([&](Material& m) { white(m), m.transmission = 0.5F; }), 1.01);
    EXPECT_LE(lightOfSphere([&](Material& m) { white(m), m.index_of_refraction = 3.0F; }), 1.01);
    EXPECT_LE(lightOfSphere([&](Material& m) {
                  white(m), m.transmission = 1.0F, m.thickness = 1.0F, m.roughness = 0.5F;
              }),
              1.01);
}

TEST(Paths, ClearGlassTakesNoLight) {
    for (const float thickness : {0.0F, 1.0F})
        EXPECT_NEAR(lightOfSphere([&](Material& material) {
                        material.base_color = {255, 255, 255, 255};
                        material.roughness = 0.0F;
                        material.transmission = 1.0F;
                        material.thickness = thickness;
                    }),
                    1.0, 0.01)
            << thickness;
}

TEST(Paths, GlassTakesAsMuchLightAsItsWayIsLong) {
    // Of index 1 it bends nothing: straight on the way through the middle is ten units long.
    SceneContent content;
    addLook(content, boxMesh({-10, -10, -10}, {10, 10, 0}), [](Material& material) {
        material.base_color = {255, 255, 255, 255};
        material.transmission = 1.0F;
        material.roughness = 0.0F;
        material.index_of_refraction = 1.0F;
        material.thickness = 1.0F;
        material.attenuation_distance = 10.0F;
        material.attenuation_color = {0.5F, 0.25F, 1.0F};
    });
    const RenderLayers layers = inEvenLight(content, topView(2.0), 8, 16);
    EXPECT_NEAR(lightAt(layers, 0, 4, 4), 0.5, 0.002);
    EXPECT_NEAR(lightAt(layers, 1, 4, 4), 0.25, 0.002);
    EXPECT_NEAR(lightAt(layers, 2, 4, 4), 1.0, 0.002);
}

SceneContent stripesUnder(const std::function<void(SceneContent&)>& add) {
    SceneContent content;
    for (int i = 0; i < 8; ++i) {
        const auto x = static_cast<float>(2 * i - 8);
        addMesh(content, floorMesh(x, -8.0F, x + 1.0F, 8.0F, 0.0F), {20, 20, 20, 255});
        addMesh(content, floorMesh(x + 1.0F, -8.0F, x + 2.0F, 8.0F, 0.0F), {230, 230, 230, 255});
    }
    add(content);
    content.lights = {sunLight({0, 0, 1})}; // below the horizon: the sky alone shines
    return content;
}

double greatestDifference(const Image& a, const Image& b) {
    double greatest = 0.0;
    for (int y = 0; y < a.height; ++y)
        for (int x = 0; x < a.width; ++x)
            greatest = std::max(greatest, std::abs(brightness(a, x, y) - brightness(b, x, y)));
    return greatest;
}

TEST(Paths, GlassOfIndexOneIsInvisible) {
    const RenderRequest request{48, 48, 64};
    const Image open = rendered(stripesUnder([](SceneContent&) {}), topView(6.0), request);
    const auto glass = [](Material& material) {
        material.base_color = {255, 255, 255, 255};
        material.transmission = 1.0F;
        material.roughness = 0.0F;
        material.index_of_refraction = 1.0F;
        material.thickness = 1.0F;
    };
    const Image covered = rendered(stripesUnder([&](SceneContent& content) {
                                       addLook(content, sphereMesh({0, 0, 4}, 3.0F, 48), glass);
                                   }),
                                   topView(6.0), request);
    show(open, "open");
    show(covered, "covered");
    EXPECT_LE(greatestDifference(open, covered), 10.0);
}

TEST(Paths, MirrorShowsWhatStandsOppositeToThePixel) {
    // A mirror that leans at 45 degrees shows the wall beside it to a camera above it.
    SceneContent content;
    KM_Mesh slope;
    slope.m_V = {{-4, -4, -4}, {4, -4, 4}, {4, 4, 4}, {-4, 4, -4}};
    slope.m_F = {{{0, 1, 2}}, {{0, 2, 3}}};
    addLook(content, slope, [](Material& material) {
        material.base_color = {255, 255, 255, 255};
        material.metalness = 1.0F;
        material.roughness = 0.0F;
    });
    // Light stripes at heights of the wall, which the mirror shows at the same x.
    const auto stripe = [&](float z0, float z1, const LinearRgb& light) {
        KM_Mesh wall;
        wall.m_V = {{-20, -30, z0}, {-20, 30, z0}, {-20, 30, z1}, {-20, -30, z1}};
        wall.m_F = {{{0, 1, 2}}, {{0, 2, 3}}};
        addLook(content, wall, [&](Material& material) {
            material.base_color = {0, 0, 0, 255};
            material.emission = light;
        });
    };
    stripe(-4.0F, 0.0F, {0.5F, 0.0F, 0.0F});
    stripe(0.0F, 4.0F, {0.0F, 0.5F, 0.0F});
    const RenderLayers layers = inEvenLight(content, topView(4.0), 16, 64);
    for (const int x : {2, 5, 10, 13}) {
        const bool is_low = x < 8;
        EXPECT_NEAR(lightAt(layers, is_low ? 0 : 1, x, 8), 0.5, 0.01) << x;
        EXPECT_NEAR(lightAt(layers, is_low ? 1 : 0, x, 8), 0.0, 0.01) << x;
    }
}

/// The light that a square of side 2 at height h sends to the floor below its middle: four times
/// the form factor of J. R. Howell's catalog, B-3, with a / h = b / h = 1 / h.
double lightUnderSquare(double height) {
    const double x = 1.0 / height;
    const double root = std::sqrt(1.0 + x * x);
    return 4.0 / (2.0 * std::numbers::pi) * 2.0 * (x / root) * std::atan(x / root);
}

TEST(Paths, ShiningSquareLightsTheFloorByItsFormFactor) {
    SceneContent content;
    addMesh(content, floorMesh(-40.0F, -40.0F, 40.0F, 40.0F, 0.0F), {255, 255, 255, 255});
    KM_Mesh lamp = floorMesh(-1.0F, -1.0F, 1.0F, 1.0F, 3.0F);
    addLook(content, lamp, [](Material& material) {
        material.base_color = {0, 0, 0, 255};
        material.emission = {8.0F, 8.0F, 8.0F};
    });
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    const SampleSequence sequence(1024);
    RenderTables tables;
    // A camera below the square, which would hide the floor, and close to the floor.
    const KM_Viewport camera = perspectiveView({2.0, 0.0, 1.0}, {0.0, 0.0, 0.0});
    RenderSetup setup =
        makeRenderSetup(scene, camera, 16, 16, sequence, renderKernelInForce(), tables);
    for (FrameSetup* frame : {&setup.frame, &setup.bounce}) {
        frame->sun_count = frame->fixed_count = frame->soft_box_count = 0;
        for (int c = 0; c < 3; ++c)
            frame->sky_horizon[c] = frame->sky_zenith[c] = frame->sky_nadir[c] =
                frame->sky_side[c] = frame->sky_glow[c] = 0.0F;
    }
    RenderLayers layers(16, 16);
    renderKernelInForce().render_block(setup, {0, 0, 16, 16}, 0, 1024, layers.sums());
    EXPECT_NEAR(lightAt(layers, 1, 8, 8), 8.0 * lightUnderSquare(3.0), 0.02 * 8.0);
}

TEST(Paths, UnlitSurfacesShowTheirColor) {
    SceneContent content;
    addLook(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F), [](Material& material) {
        material.base_color = {200, 100, 50, 255};
        material.is_unlit = true;
    });
    const Image image = rendered(content, topView(5.0), {16, 16, 4});
    EXPECT_NEAR(image.pixel(8, 8)[0], 200, 1);
    EXPECT_NEAR(image.pixel(8, 8)[1], 100, 1);
    EXPECT_NEAR(image.pixel(8, 8)[2], 50, 1);
}

TEST(Paths, NormalMapOfATiltedPlaneShadesLikeTheTiltedPlane) {
    const auto metal = [](Material& material) {
        material.base_color = {230, 200, 150, 255};
        material.metalness = 0.0F;
        material.roughness = 0.6F;
    };
    const double tilt = 20.0 * std::numbers::pi / 180.0;
    SceneContent mapped;
    KM_Mesh floor = floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F);
    floor.m_T = {{0.0F, 0.0F}, {1.0F, 0.0F}, {1.0F, 1.0F}, {0.0F, 1.0F}};
    addLook(mapped, floor, [&](Material& material) {
        metal(material);
        const auto channel = [](double n) {
            return static_cast<std::uint8_t>(std::lround(255.0 * (0.5 + 0.5 * n)));
        };
        material.normals.texture = textureOf(1, 1, [&](int, int) {
            return std::array<std::uint8_t, 4>{channel(std::sin(tilt)), 128,
                                               channel(std::cos(tilt)), 255};
        });
    });
    SceneContent tilted;
    KM_Mesh slope = floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F);
    for (KM_3fPoint& vertex : slope.m_V)
        vertex.z = static_cast<float>(-std::tan(tilt)) * vertex.x;
    addLook(tilted, slope, metal);
    for (SceneContent* content : {&mapped, &tilted})
        content->lights = {sunLight({-1, 0.5, -1.5})};
    const RenderRequest request{8, 8, 256};
    const Image a = rendered(mapped, topView(1.0), request);
    const Image b = rendered(tilted, topView(1.0), request);
    for (std::size_t c = 0; c < 3; ++c)
        EXPECT_NEAR(a.pixel(4, 4)[c], b.pixel(4, 4)[c], 6) << c;
}

TEST(Paths, HostileNumbersGiveFinitePictures) {
    SceneContent content;
    addLook(content, sphereMesh(KM_3dPoint::Origin, 3.0F, 16), [](Material& material) {
        material.emission = {1e30F, 1e30F, 1e30F};
        material.transmission = 1.0F;
        material.thickness = 1e30F;
        material.attenuation_distance = 1e-38F;
        material.attenuation_color = {0.0F, 0.0F, 0.0F};
        material.clearcoat = 1.0F;
    });
    addLook(content, sphereMesh({8, 0, 0}, 3.0F, 16), [](Material& material) {
        material.transmission = 1.0F;
        material.index_of_refraction = 1e30F;
        material.thickness = 1.0F;
        material.specular_color = {1e30F, 0.0F, 1e30F};
    });
    const RenderLayers layers = inEvenLight(content, topView(12.0), 16, 16);
    for (int y = 0; y < 16; ++y)
        for (int x = 0; x < 16; ++x)
            for (int c = 0; c < 3; ++c)
                EXPECT_TRUE(std::isfinite(lightAt(layers, c, x, y))) << x << ' ' << y;
}

} // namespace
} // namespace quarn
