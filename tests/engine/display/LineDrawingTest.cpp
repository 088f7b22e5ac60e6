#include "tests/engine/display/DisplayFixture.h"

#include "engine/display/LineRaster.h"
#include "engine/display/MeshEdges.h"

#include <gtest/gtest.h>

#include <cmath>

namespace quarn {
namespace {

/// White pixels with black lines on them.
class Paper {
public:
    Paper(int width, int height) : m_width(width), m_height(height) {
        m_pixels.assign(static_cast<std::size_t>(width * height), 0xFFFFFFFFU);
    }
    void draw(const std::vector<ScreenSegment>& segments, float line_width, float opacity = 1.0F) {
        LineBatch batch;
        batch.reset({{0, 0, 0, 255}, opacity, line_width});
        for (const ScreenSegment& s : segments)
            batch.add(s);
        batch.sortIntoBands(m_height);
        drawLines({&batch, 1}, {m_pixels.data(), m_width, m_height, nullptr});
    }
    /// How much of a pixel is covered, from 0 to 1.
    double cover(int x, int y) const {
        return 1.0 - (m_pixels[static_cast<std::size_t>(y * m_width + x)] & 255U) / 255.0;
    }
    double total() const {
        double sum = 0.0;
        for (int y = 0; y < m_height; ++y)
            for (int x = 0; x < m_width; ++x)
                sum += cover(x, y);
        return sum;
    }

private:
    int m_width;
    int m_height;
    std::vector<std::uint32_t> m_pixels;
};

ScreenSegment segment(float x0, float y0, float x1, float y1) {
    return {{x0, y0, 1}, {x1, y1, 1}};
}

TEST(LineRaster, HorizontalLineThroughPixelMiddlesCoversThemFully) {
    Paper paper(40, 40);
    paper.draw({segment(5.0F, 20.5F, 35.0F, 20.5F)}, 1.0F);
    for (int x = 5; x < 35; ++x) {
        EXPECT_EQ(paper.cover(x, 20), 1.0);
        EXPECT_EQ(paper.cover(x, 19), 0.0);
        EXPECT_EQ(paper.cover(x, 21), 0.0);
    }
    EXPECT_EQ(paper.cover(2, 20), 0.0);
}

TEST(LineRaster, LineBetweenTwoRowsCoversBothByHalf) {
    Paper paper(40, 40);
    paper.draw({segment(5.0F, 16.0F, 35.0F, 16.0F)}, 1.0F); // on the border of two bands
    EXPECT_NEAR(paper.cover(20, 15), 0.5, 0.01);
    EXPECT_NEAR(paper.cover(20, 16), 0.5, 0.01);
    EXPECT_EQ(paper.cover(20, 14), 0.0);
    EXPECT_EQ(paper.cover(20, 17), 0.0);
}

TEST(LineRaster, VerticalLineIsTheHorizontalOneTurned) {
    Paper across(50, 50);
    across.draw({segment(3.2F, 20.3F, 44.1F, 20.3F)}, 1.6F);
    Paper down(50, 50);
    down.draw({segment(20.3F, 3.2F, 20.3F, 44.1F)}, 1.6F);
    for (int y = 0; y < 50; ++y)
        for (int x = 0; x < 50; ++x)
            EXPECT_EQ(across.cover(x, y), down.cover(y, x));
}

TEST(LineRaster, DiagonalLineIsSymmetricAndAsWideAsAsked) {
    Paper paper(60, 60);
    paper.draw({segment(10.0F, 10.0F, 50.0F, 50.0F)}, 2.0F);
    for (int i = 15; i < 45; ++i) {
        EXPECT_EQ(paper.cover(i, i), 1.0);
        EXPECT_EQ(paper.cover(i, i + 1), paper.cover(i + 1, i));
        // Pixel middles one step aside lie 0.7071 from the line: 1 + 0.5 - 0.7071.
        EXPECT_NEAR(paper.cover(i, i + 1), 0.793, 0.01);
    }
}

TEST(LineRaster, CoverAddsUpToLengthTimesWidth) {
    for (const float angle : {0.0F, 0.3F, 0.7F, 1.2F, 1.5F}) {
        Paper paper(140, 140);
        const float x = 100.0F * std::cos(angle);
        const float y = 100.0F * std::sin(angle);
        paper.draw({segment(20.0F, 20.0F, 20.0F + x, 20.0F + y)}, 2.0F);
        EXPECT_NEAR(paper.total(), 200.0, 10.0) << angle;
    }
}

TEST(LineRaster, JointOfAPolylineIsNoDarkerThanItsLines) {
    Paper paper(60, 20);
    paper.draw({segment(5.0F, 8.0F, 30.0F, 8.0F), segment(30.0F, 8.0F, 55.0F, 8.0F)}, 1.0F);
    for (int x = 10; x < 50; ++x)
        EXPECT_NEAR(paper.cover(x, 7), 0.5, 0.01);
}

TEST(LineRaster, FaintLinesAreBlended) {
    Paper paper(40, 20);
    paper.draw({segment(5.0F, 10.5F, 35.0F, 10.5F)}, 1.0F, 0.25F);
    EXPECT_NEAR(paper.cover(20, 10), 0.25, 0.01);
}

TEST(MeshEdges, BoxHasTwelveEdgesAndNoDiagonals) {
    const MeshEdges edges(boxMesh({0.0, 0.0, 0.0}, {1.0, 2.0, 3.0}));
    EXPECT_EQ(edges.features().size(), 12U);
    EXPECT_TRUE(edges.smooth().empty());
}

TEST(MeshEdges, FacesThatShareNoVerticesHaveTheSameEdges) {
    const KM_Mesh box = boxMesh({0.0, 0.0, 0.0}, {1.0, 2.0, 3.0});
    KM_Mesh apart;
    for (const KM_MeshTriangle& t : box.m_F) {
        const auto first = static_cast<std::uint32_t>(apart.m_V.size());
        for (const std::uint32_t v : t.vi)
            apart.m_V.push_back(box.m_V[v]);
        apart.m_F.push_back({{first, first + 1, first + 2}});
    }
    EXPECT_EQ(MeshEdges(apart).features().size(), 12U);
}

TEST(MeshEdges, OpenRectangleHasItsFourBorders) {
    const MeshEdges edges(floorMesh(0.0F, 0.0F, 1.0F, 1.0F, 0.0F));
    EXPECT_EQ(edges.features().size(), 4U);
    EXPECT_TRUE(edges.smooth().empty());
}

TEST(MeshEdges, SphereHasSmoothEdgesOnly) {
    const MeshEdges edges(sphereMesh({0.0, 0.0, 0.0}, 1.0F, 16));
    EXPECT_TRUE(edges.features().empty());
    EXPECT_GT(edges.smooth().size(), 32U * 15U);
    EXPECT_GT(edges.meanInnerLength(), 0.05);
}

TEST(MeshEdges, ThreeTrianglesAtOneEdgeMakeItAFeature) {
    KM_Mesh mesh;
    mesh.m_V = {{0, 0, 0}, {1, 0, 0}, {0, 1, 0}, {0, -1, 0}, {0, 0, 1}};
    mesh.m_F = {{{0, 1, 2}}, {{1, 0, 3}}, {{0, 1, 4}}};
    EXPECT_EQ(MeshEdges(mesh).features().size(), 7U); // six borders and the common edge
}

SceneContent curveOverBox(double height) {
    SceneContent content;
    addMesh(content, boxMesh({-2.0, -2.0, 0.0}, {2.0, 2.0, 1.0}), {230, 230, 230, 255});
    SceneCurve curve;
    curve.polyline.Append(KM_3dPoint(-4.0, 0.05, height));
    curve.polyline.Append(KM_3dPoint(4.0, 0.05, height));
    curve.color = {200, 0, 0, 255};
    content.curves.push_back(curve);
    return content;
}

bool isRed(const Image& image, int x, int y) {
    const auto pixel = image.pixel(x, y);
    return pixel[0] > pixel[1] + 60;
}

Image plan(const SceneContent& content, const wchar_t* mode) {
    return drawn(content, topView(5.0), modeNamed(mode, 2), 100, 100);
}

TEST(LineDrawing, CurveAboveASurfaceIsSeenInEveryMode) {
    for (const DisplayModeAttributes& mode : standardDisplayModes())
        EXPECT_TRUE(isRed(plan(curveOverBox(2.0), mode.english_name.data()), 50, 49))
            << KM_wString(mode.english_name).ToUtf8();
}

TEST(LineDrawing, CurveOnASurfaceIsSeen) {
    EXPECT_TRUE(isRed(plan(curveOverBox(1.0), L"Shaded"), 50, 49));
    EXPECT_TRUE(isRed(plan(curveOverBox(1.0), L"Rendered"), 50, 49));
}

TEST(LineDrawing, CurveBehindASurfaceIsHiddenWhereSurfacesAre) {
    for (const wchar_t* mode : {L"Shaded", L"Rendered", L"Drawing", L"Clay"}) {
        const Image image = plan(curveOverBox(-1.0), mode);
        EXPECT_FALSE(isRed(image, 50, 49));
        EXPECT_TRUE(isRed(image, 15, 49)); // beside the box
    }
    EXPECT_TRUE(isRed(plan(curveOverBox(-1.0), L"Wireframe"), 50, 49));
    EXPECT_TRUE(isRed(plan(curveOverBox(-1.0), L"X-Ray"), 50, 49));
}

TEST(LineDrawing, HiddenCurveIsNotDrawn) {
    SceneContent content = curveOverBox(2.0);
    content.curves[0].visible = false;
    EXPECT_FALSE(isRed(plan(content, L"Shaded"), 50, 49));
}

TEST(LineDrawing, PointIsADotOfItsSize) {
    SceneContent content;
    content.points.push_back({KM_CreateUuid(), {0.0, 0.0, 0.0}, {200, 0, 0, 255}, true});
    const Image image = plan(content, L"Wireframe");
    int count = 0;
    for (int y = 0; y < 100; ++y)
        for (int x = 0; x < 100; ++x)
            count += isRed(image, x, y) ? 1 : 0;
    EXPECT_GE(count, 12); // a disc of diameter 5 covers 19.6 pixels
    EXPECT_LE(count, 32);
}

TEST(LineDrawing, CurveThatPassesTheCameraIsCutOffBeforeIt) {
    SceneContent content;
    SceneCurve curve;
    curve.polyline.Append(KM_3dPoint(0.3, -50.0, -0.2)); // behind the camera
    curve.polyline.Append(KM_3dPoint(0.3, 50.0, -0.2));
    curve.color = {200, 0, 0, 255};
    content.curves.push_back(curve);
    const Image image = drawn(content, perspectiveView({0.0, 0.0, 0.0}, {0.0, 1.0, 0.0}),
                              modeNamed(L"Wireframe"), 100, 100);
    int upper = 0;
    int lower = 0;
    for (int y = 0; y < 100; ++y)
        for (int x = 0; x < 100; ++x)
            (y < 49 ? upper : lower) += isRed(image, x, y) ? 1 : 0;
    EXPECT_EQ(upper, 0);
    EXPECT_GT(lower, 30);
}

TEST(LineDrawing, WireframeOfASmoothSphereShowsItsOutline) {
    SceneContent content;
    addMesh(content, sphereMesh({0.0, 0.0, 0.0}, 4.0F, 200));
    const Image image = plan(content, L"Wireframe");
    const double paper = brightness(image, 1, 1);
    int dark = 0;
    for (int x = 0; x < 20; ++x)
        dark += brightness(image, x, 50) < 0.7 * paper ? 1 : 0;
    EXPECT_GE(dark, 1);
    EXPECT_GT(brightness(image, 50, 40), 0.8 * paper); // the dense net within does not blacken it
}

TEST(LineDrawing, DrawingHidesTheEdgesBehind) {
    SceneContent content;
    addMesh(content, boxMesh({-2.0, -2.0, 0.0}, {2.0, 2.0, 1.0}));
    addMesh(content, boxMesh({-1.0, -1.0, -3.0}, {1.0, 1.0, -2.0}));
    const Image image = plan(content, L"Drawing");
    EXPECT_LT(brightness(image, 30, 50), 128.0); // the upper box's left side at x = -2
    EXPECT_EQ(brightness(image, 40, 50), 255.0); // the lower box's at x = -1
    EXPECT_LT(brightness(plan(content, L"Wireframe"), 40, 50), 200.0);
}

} // namespace
} // namespace quarn
