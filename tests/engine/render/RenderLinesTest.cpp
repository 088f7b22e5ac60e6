#include "tests/engine/render/RenderFixture.h"

#include <algorithm>

namespace quarn {
namespace {

constexpr KM_Color ink{20, 40, 200, 255};

std::size_t addCurve(SceneContent& content, std::initializer_list<KM_3dPoint> corners) {
    SceneCurve curve;
    curve.id = KM_CreateUuid();
    for (const KM_3dPoint& corner : corners)
        curve.polyline.Append(corner);
    curve.color = ink;
    content.curves.push_back(curve);
    return content.curves.size() - 1;
}

/// A box of 10 by 10 units, 6 high, on a floor.
SceneContent boxOnFloor() {
    SceneContent content;
    addMesh(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F));
    addMesh(content, boxMesh({-5.0, -5.0, 0.0}, {5.0, 5.0, 6.0}), {200, 80, 60, 255});
    content.lights = {sunLight({0.3, 0.2, -1.0})};
    return content;
}

/// From above; 4 pixels a unit, so that (0, 0) lies between the pixels 39 and 40.
Image seenFromAbove(const SceneContent& content) {
    return rendered(content, topView(10.0), {80, 80, 4});
}

void expectInk(const Image& image, int x, int y) {
    const auto pixel = image.pixel(x, y);
    EXPECT_NEAR(pixel[0], ink.r, 2) << x << ' ' << y;
    EXPECT_NEAR(pixel[1], ink.g, 2) << x << ' ' << y;
    EXPECT_NEAR(pixel[2], ink.b, 2) << x << ' ' << y;
}

TEST(RenderedLines, CurveOnTheFloorHasItsOwnColorAndIsCrisp) {
    SceneContent content = boxOnFloor();
    const Image without = seenFromAbove(content);
    addCurve(content, {{-9.0, -8.125, 0.0}, {9.0, -8.125, 0.0}}); // through the middles of row 72
    const Image image = seenFromAbove(content);
    for (int x = 10; x < 70; x += 7) {
        expectInk(image, x, 72);
        // 1.6 pixels wide: 0.3 of the pixels above and below.
        for (const int beside : {71, 73}) {
            const double wanted = 0.7 * without.pixel(x, beside)[0] + 0.3 * ink.r;
            EXPECT_NEAR(image.pixel(x, beside)[0], wanted, 2.0);
        }
        EXPECT_TRUE(samePixel(image, x, 70, without, x, 70));
        EXPECT_TRUE(samePixel(image, x, 74, without, x, 74));
    }
}

TEST(RenderedLines, SurfacesHideWhatLiesBehindThem) {
    SceneContent content = boxOnFloor();
    const Image without = seenFromAbove(content);
    addCurve(content, {{-9.0, 0.125, 3.0}, {9.0, 0.125, 3.0}}); // through the box
    const Image image = seenFromAbove(content);
    expectInk(image, 10, 39);
    expectInk(image, 70, 39);
    for (int x = 22; x < 58; ++x)
        EXPECT_TRUE(samePixel(image, x, 39, without, x, 39)) << x;
}

TEST(RenderedLines, GlassHidesNoCurve) {
    SceneContent content = boxOnFloor();
    addPane(content, floorMesh(-9.0F, -9.5F, 9.0F, -6.0F, 4.0F), {90, 140, 200, 80});
    addCurve(content, {{-9.0, -8.125, 0.0}, {9.0, -8.125, 0.0}});
    expectInk(seenFromAbove(content), 40, 72);
}

TEST(RenderedLines, PointsAreDrawnAndWhatIsNotShownIsNot) {
    SceneContent content = boxOnFloor();
    const Image without = seenFromAbove(content);
    const std::size_t curve = addCurve(content, {{-9.0, -8.125, 0.0}, {9.0, -8.125, 0.0}});
    content.curves[curve].visible = false;
    content.points.push_back({KM_CreateUuid(), {8.125, 8.125, 0.0}, ink, true});
    content.points.push_back({KM_CreateUuid(), {-8.125, 8.125, 0.0}, ink, false});
    const Image image = seenFromAbove(content);
    for (int x = 71; x <= 73; ++x)
        for (int y = 6; y <= 8; ++y)
            expectInk(image, x, y);
    EXPECT_TRUE(samePixel(image, 7, 7, without, 7, 7));
    EXPECT_TRUE(samePixel(image, 40, 72, without, 40, 72));
}

TEST(RenderedLines, DocumentOfCurvesAloneIsRendered) {
    SceneContent content;
    addCurve(content, {{-9.0, -8.125, 0.0}, {9.0, -8.125, 0.0}});
    expectInk(seenFromAbove(content), 40, 72);
}

} // namespace
} // namespace quarn
