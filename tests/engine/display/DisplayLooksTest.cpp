#include "tests/engine/display/DisplayFixture.h"

#include "engine/display/CameraRays.h"
#include "engine/display/MeshEdges.h"
#include "engine/display/ScreenProjection.h"
#include "engine/images/ColorSpace.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cmath>

namespace quarn {
namespace {

/// The darkest pixel within one pixel of a place.
double darkestNear(const Image& image, int x, int y) {
    double darkest = 255.0;
    for (int dy = -1; dy <= 1; ++dy)
        for (int dx = -1; dx <= 1; ++dx)
            darkest = std::min(darkest, brightness(image, x + dx, y + dy));
    return darkest;
}

/// How much of the surfaces at (x, y) a horizontal line covers, 0 to 1.
double lineCover(const Image& image, const DisplayModeAttributes& mode, int x, int y) {
    const double line = (mode.edge_color.r + mode.edge_color.g + mode.edge_color.b) / 3.0;
    const double beside = 0.5 * (brightness(image, x, y - 5) + brightness(image, x, y + 5));
    return (beside - brightness(image, x, y)) / (beside - line);
}

TEST(XRay, EverySurfaceBeforeALineLeavesAPartOfIt) {
    SceneContent content;
    // 20 pixels a unit: the upper border at y = -0.025 runs through the middles of row 100.
    addMesh(content, floorMesh(-4.0F, -3.0F, 4.0F, -0.025F, 0.0F));
    addMesh(content, floorMesh(-1.3F, -4.0F, 4.4F, 4.0F, 2.0F));
    addMesh(content, floorMesh(1.5F, -4.0F, 4.6F, 4.0F, 4.0F));
    DisplayModeAttributes mode = modeNamed(L"X-Ray");
    mode.crowded_strength = 0.0F;
    const Image image = drawn(content, topView(5.0), mode, 200, 200);
    const double kept = mode.covered_strength;
    EXPECT_NEAR(lineCover(image, mode, 45, 100), 1.0, 0.06);
    EXPECT_NEAR(lineCover(image, mode, 100, 100), kept, 0.06);
    EXPECT_NEAR(lineCover(image, mode, 160, 100), kept * kept, 0.06);
}

/// Scene light of a pixel's channel.
double lightAt(const Image& image, int channel) {
    const auto index = static_cast<std::size_t>(channel);
    return sceneLightShownAs(linearFromSrgbByte(image.pixel(50, 50)[index]));
}

TEST(Translucent, FrontPaneStainsWhatComesThroughFromTheOneBehind) {
    constexpr double opacity = 0.36; // of a pane that faces the observer
    constexpr double stain = 0.55;
    const std::array<KM_Color, 2> colors{KM_Color{200, 60, 40, 255}, KM_Color{50, 90, 190, 255}};
    const auto panes = [&](bool first, float first_height, bool second, float second_height) {
        SceneContent content;
        if (first)
            addMesh(content, floorMesh(-9, -9, 9, 9, first_height), colors[0]);
        if (second)
            addMesh(content, floorMesh(-9, -9, 9, 9, second_height), colors[1]);
        return drawn(content, topView(5.0), modeNamed(L"Translucent"), 100, 100);
    };
    const Image none = panes(false, 0, false, 0);
    const std::array<Image, 2> alone{panes(true, 1, false, 0), panes(false, 0, true, 1)};
    const std::array<Image, 2> both{panes(true, 2, true, 1), panes(true, 1, true, 2)};
    for (std::size_t front = 0; front < 2; ++front) {
        const LinearColor albedo = linearFromColor(colors[front]);
        const std::array<double, 3> color{albedo.r, albedo.g, albedo.b};
        for (int c = 0; c < 3; ++c) {
            const double through =
                (1.0 - opacity) * (1.0 - stain * (1.0 - color[static_cast<std::size_t>(c)]));
            const double sent = lightAt(alone[front], c) - through * lightAt(none, c);
            const double expected = sent + through * lightAt(alone[1 - front], c);
            EXPECT_NEAR(lightAt(both[front], c), expected, 0.012) << front << ' ' << c;
        }
    }
    EXPECT_GT(lightAt(both[0], 0), 1.2 * lightAt(both[1], 0));
    EXPECT_LT(lightAt(both[0], 2), lightAt(both[1], 2));
}

TEST(Drawing, CubeShowsItsNineVisibleEdgesAndNoneOfTheHiddenThree) {
    SceneContent content;
    addMesh(content, boxMesh({-1.0, -1.0, -1.0}, {1.0, 1.0, 1.0}));
    const KM_Viewport viewport = perspectiveView({9.0, 5.0, 3.0}, {0.0, 0.0, 0.0});
    const Image image = drawn(content, viewport, modeNamed(L"Drawing", 2), 400, 300);
    const KM_BoundingBox box({-1.0, -1.0, -1.0}, {1.0, 1.0, 1.0});
    const CameraRays rays = cameraRays(viewport, 400, 300, box);
    const ScreenProjection projection(rays, 400, 300, 1.0F);
    int visible = 0;
    for (int a = 0; a < 8; ++a)
        for (const int bit : {1, 2, 4}) {
            if (a & bit)
                continue;
            const KM_3dPoint from = box.Corner(a);
            const KM_3dPoint to = box.Corner(a | bit);
            ScreenSegment s;
            ASSERT_TRUE(projection.project({from.x, from.y, from.z}, {to.x, to.y, to.z}, s));
            const int x = static_cast<int>(0.6F * s.from.x + 0.4F * s.to.x);
            const int y = static_cast<int>(0.6F * s.from.y + 0.4F * s.to.y);
            // The corner (-1, -1, -1) is the only one that the cube itself hides.
            if (a == 0)
                EXPECT_GT(darkestNear(image, x, y), 250.0) << bit;
            else
                EXPECT_LT(darkestNear(image, x, y), 150.0) << a << ' ' << bit;
            visible += a == 0 ? 0 : 1;
        }
    EXPECT_EQ(visible, 9);
}

TEST(Drawing, SphereShowsItsOutlineAllRoundAndNothingWithin) {
    SceneContent content;
    addMesh(content, sphereMesh({0.0, 0.0, 0.0}, 4.0F, 48));
    const Image image = drawn(content, topView(5.0), modeNamed(L"Drawing", 2), 300, 300);
    for (int y = 0; y < 300; ++y)
        for (int x = 0; x < 300; ++x)
            if (std::hypot(x - 149.5, y - 149.5) < 112.0) { // of 120 pixels
                ASSERT_GT(brightness(image, x, y), 250.0) << x << ' ' << y;
            }
    for (int i = 0; i < 36; ++i) {
        const double angle = KM_PI * i / 18.0;
        double darkest = 255.0;
        for (double r = 115.0; r < 123.0; r += 0.5)
            darkest = std::min(darkest, brightness(image, int(150 + r * std::cos(angle)),
                                                   int(150 + r * std::sin(angle))));
        EXPECT_LT(darkest, 120.0) << i;
    }
}

TEST(Drawing, JointOfTwoWallsInOnePlaneShowsNoLine) {
    SceneContent content;
    addMesh(content, boxMesh({-3.0, -2.0, 0.0}, {0.0, 2.0, 1.0}));
    addMesh(content, boxMesh({0.0, -2.0, 0.0}, {3.0, 2.0, 1.0}));
    const Image image = drawn(content, topView(5.0), modeNamed(L"Drawing", 2), 200, 200);
    for (int y = 65; y < 135; ++y)
        EXPECT_GT(darkestNear(image, 100, y), 250.0) << y;
    EXPECT_LT(darkestNear(image, 40, 100), 100.0); // the outer border at x = -3
    EXPECT_LT(darkestNear(image, 100, 60), 100.0); // and at y = 2
}

TEST(Drawing, OutlinesAreThickerThanCreases) {
    SceneContent content;
    addMesh(content, boxMesh({-1.0, -1.0, -1.0}, {1.0, 1.0, 1.0}));
    // Level with the middle and 45 degrees aside: the near edge stands upright in the middle.
    const KM_Viewport viewport = perspectiveView({8.0, -8.0, 0.0}, {0.0, 0.0, 0.0});
    const Image image = drawn(content, viewport, modeNamed(L"Drawing", 2), 400, 300);
    const auto inkBetween = [&](int left, int right) {
        double sum = 0.0;
        for (int x = left; x < right; ++x)
            sum += 1.0 - brightness(image, x, 150) / 255.0;
        return sum;
    };
    EXPECT_NEAR(inkBetween(190, 210), 0.9 * 0.85, 0.25); // width and strength of a crease
    EXPECT_NEAR(inkBetween(0, 190), 2.1, 0.4);           // width of an outline
}

TEST(Clay, OpenFloorIsWhiteAndAsEvenAsPaper) {
    SceneContent content;
    addMesh(content, floorMesh(-20.0F, -20.0F, 20.0F, 20.0F, 0.0F), {200, 40, 40, 255});
    content.lights.push_back(sunLight({0.3, 0.2, -0.9}));
    const Image image = drawn(content, topView(5.0), modeNamed(L"Clay", 2), 101, 77);
    for (int y = 0; y < 77; ++y)
        for (int x = 0; x < 101; ++x)
            ASSERT_TRUE(samePixel(image, x, y, image, 50, 38)) << x << ' ' << y;
    const auto pixel = image.pixel(50, 38);
    EXPECT_GE(*std::min_element(pixel.begin(), pixel.begin() + 3), 215);
    EXPECT_LE(std::abs(pixel[0] - pixel[2]), 4);
}

TEST(Clay, AWhiteModelStandsOutFromTheGround) {
    SceneContent content;
    addMesh(content, floorMesh(-2.0F, -2.0F, 2.0F, 2.0F, 0.0F));
    content.lights.push_back(sunLight({0.3, 0.2, -0.9}));
    const Image image = drawn(content, topView(5.0), modeNamed(L"Clay", 2), 100, 100);
    const double model = brightness(image, 50, 50);
    const double ground = brightness(image, 90, 50);
    EXPECT_LT(ground, model - 7.0);
    EXPECT_GT(ground, model - 25.0);
}

TEST(Clay, CornerDarkensSmoothlyAndWithoutNoise) {
    SceneContent content;
    addMesh(content, floorMesh(-20.0F, -20.0F, 20.0F, 20.0F, 0.0F));
    addMesh(content, boxMesh({-20.0, 2.0, 0.0}, {20.0, 3.0, 8.0}));
    content.lights.push_back(sunLight({0.0, 0.5, -0.9})); // toward the wall: no shadow before it
    const Image image = drawn(content, topView(5.0), modeNamed(L"Clay", 2), 160, 160);
    // 16 pixels a unit: the wall begins at row 48.
    double before = 0.0;
    for (int y = 49; y < 160; ++y) {
        double least = 255.0;
        double most = 0.0;
        for (int x = 10; x < 150; ++x) {
            least = std::min(least, brightness(image, x, y));
            most = std::max(most, brightness(image, x, y));
        }
        EXPECT_LE(most - least, 2.0) << y;  // along the wall nothing changes
        EXPECT_GE(most, before - 1.0) << y; // away from it light only grows
        before = most;
    }
    EXPECT_LT(brightness(image, 80, 50), brightness(image, 80, 150) - 15.0);
}

TEST(Wireframe, AllEdgesAreDrawnOnlyWhenAskedFor) {
    SceneContent content;
    addMesh(content, hillMesh(16));
    const KM_Viewport viewport = perspectiveView({0.0, -90.0, 60.0}, {0.0, 0.0, 0.0});
    const DisplayModeAttributes mode = modeNamed(L"Wireframe");
    const auto mean = [&](MeshEdgeChoice choice) {
        return meanBrightness(drawn(content, viewport, withEdges(mode, choice), 320, 240));
    };
    EXPECT_EQ(mean(MeshEdgeChoice::standard), mean(MeshEdgeChoice::features));
    EXPECT_LT(mean(MeshEdgeChoice::all), mean(MeshEdgeChoice::features) - 2.0);
}

TEST(Wireframe, DenseMeshesStayLight) {
    for (const int cells : {30, 100, 300}) {
        SceneContent content;
        addMesh(content, hillMesh(cells));
        const KM_Viewport viewport = perspectiveView({0.0, -90.0, 60.0}, {0.0, 0.0, 0.0});
        const Image image = drawn(
            content, viewport, withEdges(modeNamed(L"Wireframe"), MeshEdgeChoice::all), 320, 240);
        const double paper = brightness(image, 1, 1);
        double darkest_block = 255.0;
        for (int y = 0; y + 16 <= 240; y += 16)
            for (int x = 0; x + 16 <= 320; x += 16) {
                double sum = 0.0;
                for (int i = 0; i < 256; ++i)
                    sum += brightness(image, x + i % 16, y + i / 16);
                darkest_block = std::min(darkest_block, sum / 256.0);
            }
        EXPECT_GT(darkest_block, 0.6 * paper) << cells;
    }
}

// A grey wall that looks north, and the sun in the south: what it has is from sky and ground.
TEST(Rendered, AWallInShadeIsNeitherBlueNorDull) {
    SceneContent content;
    addMesh(content, boxMesh({-3.0, -3.0, 0.0}, {3.0, 3.0, 4.0}));
    content.lights.push_back(sunLight({0.0, 1.0, -1.0}));
    const KM_Viewport viewport = perspectiveView({0.0, 14.0, 2.0}, {0.0, 3.0, 2.0});
    const Image image = drawn(content, viewport, modeNamed(L"Rendered"), 100, 100);
    EXPECT_LT(lightAt(image, 2), 1.15 * lightAt(image, 0));
    EXPECT_GT(lightAt(image, 1), 0.18); // of the 0.60 that the grey sends back in full light
    EXPECT_LT(lightAt(image, 1), 0.30);
}

/// Folds along x over [-4, 4]^2, so steep that each is a crease.
KM_Mesh foldedSheet(int folds) {
    KM_Mesh mesh;
    for (int i = 0; i <= folds; ++i)
        for (const float x : {-4.0F, 4.0F})
            mesh.m_V.emplace_back(x,
                                  -4.0F + 8.0F * static_cast<float>(i) / static_cast<float>(folds),
                                  i % 2 == 0 ? 0.0F : 0.1F);
    for (std::uint32_t i = 0; i < 2 * static_cast<std::uint32_t>(folds); i += 2) {
        mesh.m_F.push_back({{i, i + 1, i + 3}});
        mesh.m_F.push_back({{i, i + 3, i + 2}});
    }
    return mesh;
}

// Folds stand 4 pixels apart; the pane's border at x = -1 crosses them.
TEST(Wireframe, AnOutlineStandsOutFromACrowdOfCreases) {
    SceneContent content;
    addMesh(content, foldedSheet(40));
    addMesh(content, floorMesh(-1.0F, -3.0F, 1.0F, 3.0F, 0.0F));
    const Image image = drawn(content, topView(5.0), modeNamed(L"Wireframe"), 200, 200);
    const double paper = brightness(image, 1, 1);
    const auto inkBetween = [&](int left, int right) {
        double sum = 0.0;
        for (int y = 80; y < 120; ++y)
            for (int x = left; x < right; ++x)
                sum += paper - brightness(image, x, y);
        return sum / (40.0 * (right - left));
    };
    const double crowd = inkBetween(50, 70);
    EXPECT_GT(crowd, 12.0);
    EXPECT_LT(crowd, 60.0);
    EXPECT_GT(inkBetween(79, 81), 2.5 * crowd);
}

TEST(Shaded, EdgesAreOffUntilTheyAreChosen) {
    SceneContent content;
    addMesh(content, boxMesh({-3.0, -3.0, 0.0}, {3.0, 3.0, 1.0}), {200, 200, 200, 255});
    addMesh(content, boxMesh({-1.0, -1.0, 1.0}, {1.0, 1.0, 2.0}), {200, 200, 200, 255});
    const DisplayModeAttributes mode = modeNamed(L"Shaded");
    const Image plain = drawn(content, topView(5.0), mode, 200, 200);
    const Image edges =
        drawn(content, topView(5.0), withEdges(mode, MeshEdgeChoice::features), 200, 200);
    EXPECT_NEAR(darkestNear(plain, 80, 100), brightness(plain, 100, 100), 3.0); // at x = -1
    EXPECT_LT(darkestNear(edges, 80, 100), 0.6 * brightness(edges, 100, 100));
    EXPECT_TRUE(samePixel(plain, 100, 100, edges, 100, 100));
}

TEST(MeshEdges, NormalsThatRunOnMakeACoarseSurfaceSmooth) {
    KM_Mesh sphere = sphereMesh({0.0, 0.0, 0.0}, 1.0F, 5); // triangles meet at about 36 degrees
    EXPECT_TRUE(MeshEdges(sphere).features().empty());
    sphere.m_N.clear();
    EXPECT_GT(MeshEdges(sphere).features().size(), 20U);
}

TEST(MeshEdges, FlatEdgesAreThoseWithinAPlane) {
    const MeshEdges edges(boxMesh({0.0, 0.0, 0.0}, {1.0, 2.0, 3.0}));
    EXPECT_EQ(edges.flat().size(), 6U);      // one diagonal a side
    EXPECT_GT(edges.meanInnerLength(), 2.2); // the shortest is sqrt(1 + 4)
}

} // namespace
} // namespace quarn
