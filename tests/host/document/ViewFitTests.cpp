#include "host/document/CameraMove.h"
#include "host/document/ViewFit.h"
#include "tests/host/document/DocumentFixtures.h"

#include <algorithm>

namespace quarn::test {
namespace {

constexpr int WIDTH = 1280;
constexpr int HEIGHT = 720;

/// How far out of the middle of the picture a document's corners are seen: 1 is its border.
struct Extent {
    double farthest = 0.0;
    double top = 1.0;     ///< highest place, -1 being the upper border
    double bottom = -1.0; ///< lowest place, 1 being the lower border
    bool all_in_front = true;

    void add(const KM_Viewport& viewport, const Document& document) {
        for (const auto& object : document.objects().objects()) {
            if (!object->visible)
                continue;
            for (const KM_3fPoint& vertex : object->placed.mesh->m_V)
                add(viewport, vertex.ToDouble());
        }
    }

    void add(const KM_Viewport& viewport, const KM_3dPoint& point) {
        double x = 0.0;
        double y = 0.0;
        double depth = 0.0;
        const bool is_seen = viewport.WorldToScreen(point, &x, &y, &depth);
        all_in_front = all_in_front && is_seen && depth > 0.0;
        const double down = 2.0 * y / HEIGHT - 1.0;
        farthest = std::max({farthest, std::abs(2.0 * x / WIDTH - 1.0), std::abs(down)});
        top = std::min(top, down);
        bottom = std::max(bottom, down);
    }
};

/// The camera after a turn about the vertical through its target.
KM_Viewport turned(const KM_Viewport& viewport, double angle) {
    const KM_Xform turn = KM_Xform::Rotation(angle, KM_3dVector::ZAxis, viewport.TargetPoint());
    KM_Viewport result = viewport;
    EXPECT_TRUE(moveCamera(result, viewport.TargetPoint(), turn * viewport.CameraLocation(), true));
    return result;
}

struct Shape {
    const char* name;
    KM_3dPoint low;
    KM_3dPoint high;
};

void PrintTo(const Shape& shape, std::ostream* stream) {
    *stream << shape.name;
}

class ViewFitTest : public DocumentTest, public testing::WithParamInterface<Shape> {
protected:
    ViewFitTest() {
        view.setFrameSize(WIDTH, HEIGHT);
        addBox(document, GetParam().low, GetParam().high);
    }

    KM_Viewport fit(const ViewFit& wish) {
        const auto fitted = fitViewport(view.viewport(), document.objects(), wish);
        EXPECT_TRUE(fitted.ok());
        return fitted ? fitted.value() : KM_Viewport();
    }

    void look(double azimuth_deg, double elevation_deg) {
        const double azimuth = azimuth_deg * KM_PI / 180.0;
        const double elevation = elevation_deg * KM_PI / 180.0;
        const KM_3dVector out(std::cos(azimuth) * std::cos(elevation),
                              std::sin(azimuth) * std::cos(elevation), std::sin(elevation));
        view.setTargetAndCamera({0, 0, 0}, KM_3dPoint(100.0 * out), true, true);
    }
};

TEST_P(ViewFitTest, EverythingIsSeenAndReachesTheBorderNearly) {
    for (const double elevation : {-30.0, 0.0, 20.0, 60.0, 89.0}) {
        for (int azimuth = 0; azimuth < 360; azimuth += 45) {
            look(azimuth, elevation);
            Extent extent;
            extent.add(fit({}), document);
            EXPECT_TRUE(extent.all_in_front);
            EXPECT_LE(extent.farthest, 0.951) << elevation << ", " << azimuth;
            EXPECT_GE(extent.farthest, 0.9) << elevation << ", " << azimuth;
        }
    }
}

TEST_P(ViewFitTest, ATurnStaysInTheFrameAndUsesIt) {
    for (const double elevation : {0.0, 20.0, 50.0, 80.0}) {
        look(-60.0, elevation);
        const KM_Viewport fitted = fit({.turn = true});
        Extent extent;
        for (int frame = 0; frame < 36; ++frame)
            extent.add(turned(fitted, frame * KM_PI / 18.0), document);
        EXPECT_TRUE(extent.all_in_front) << elevation;
        EXPECT_LE(extent.farthest, 0.951) << elevation;
        EXPECT_GE(extent.farthest, 0.9) << elevation;
    }
}

TEST_P(ViewFitTest, AParallelTurnStaysInTheFrameAndUsesIt) {
    look(-60.0, 30.0);
    KM_Viewport parallel = view.viewport();
    parallel.SetProjection(KM_parallel_view);
    view.setViewport(parallel, true, true);
    const KM_Viewport fitted = fit({.turn = true});
    Extent extent;
    for (int frame = 0; frame < 36; ++frame)
        extent.add(turned(fitted, frame * KM_PI / 18.0), document);
    EXPECT_TRUE(extent.all_in_front);
    EXPECT_LE(extent.farthest, 0.951);
    EXPECT_GE(extent.farthest, 0.9);
}

TEST_P(ViewFitTest, ATurnFillsThePictureAsFarUpAsDown) {
    for (const double elevation : {0.0, 20.0, 50.0}) {
        look(-60.0, elevation);
        const KM_Viewport fitted = fit({.turn = true});
        Extent extent;
        for (int frame = 0; frame < 360; ++frame)
            extent.add(turned(fitted, frame * KM_PI / 180.0), document);
        EXPECT_NEAR(extent.top, -extent.bottom, 0.002) << elevation;
    }
}

TEST_P(ViewFitTest, ATurnGoesAboutTheVerticalThroughTheMiddle) {
    look(30.0, 25.0);
    const KM_3dVector before = view.viewport().CameraZ();
    const KM_Viewport fitted = fit({.turn = true});
    EXPECT_NEAR((fitted.CameraZ() - before).Length(), 0.0, 1e-9);
    const KM_3dPoint middle = document.objects().visibleBox().Center();
    EXPECT_EQ(fitted.TargetPoint().x, middle.x);
    EXPECT_EQ(fitted.TargetPoint().y, middle.y);
}

TEST_P(ViewFitTest, KeepsTheDirectionAndTakesTheMiddleAsTarget) {
    look(30.0, 25.0);
    const KM_3dVector before = view.viewport().CameraZ();
    const KM_Viewport fitted = fit({});
    EXPECT_NEAR((fitted.CameraZ() - before).Length(), 0.0, 1e-9);
    const KM_3dPoint middle = document.objects().visibleBox().Center();
    EXPECT_EQ(fitted.TargetPoint(), middle);
    EXPECT_NEAR(fitted.TargetDistance(), fitted.CameraLocation().DistanceTo(middle),
                1e-9 * fitted.TargetDistance());
}

TEST_P(ViewFitTest, DistanceTwoStandsTwiceAsFar) {
    const double once = fit({.turn = true}).TargetDistance();
    const double twice = fit({.turn = true, .distance = 2.0}).TargetDistance();
    EXPECT_NEAR(twice / once, 2.0, 1e-9);
}

TEST_P(ViewFitTest, AKeptTargetOutsideTheModelStillSeesAllOfATurn) {
    const KM_BoundingBox box = document.objects().visibleBox();
    const KM_3dPoint target = box.m_max + 0.5 * box.Diagonal();
    view.setTargetAndCamera(target, target + KM_3dVector(30, -40, 25), true, true);
    const KM_Viewport fitted = fit({.turn = true, .keep_target = true});
    EXPECT_EQ(fitted.TargetPoint(), target);
    Extent extent;
    for (int frame = 0; frame < 36; ++frame)
        extent.add(turned(fitted, frame * KM_PI / 18.0), document);
    EXPECT_TRUE(extent.all_in_front);
    EXPECT_LE(extent.farthest, 0.951);
    EXPECT_GE(extent.farthest, 0.85);
}

INSTANTIATE_TEST_SUITE_P(
    Shapes, ViewFitTest,
    testing::Values(Shape{"Plate", {-50, -50, 0}, {50, 50, 0.1}},
                    Shape{"Bridge", {0, 0, 0}, {1000, 12, 8}},
                    Shape{"Tower", {100, 100, 0}, {120, 120, 300}},
                    Shape{"ModelInMillimetres", {4000, -2000, 100}, {12000, 5000, 6000}},
                    Shape{"AMillimetreInMetres", {0, 0, 0}, {0.001, 0.001, 0.001}},
                    Shape{"Wall", {0, 0, 0}, {0.2, 30, 3}}),
    [](const auto& shape) { return std::string(shape.param.name); });

using ViewFitLimitTest = DocumentTest;

TEST_F(ViewFitLimitTest, AnEmptyDocumentHasNothingToFit) {
    EXPECT_FALSE(fitViewport(view.viewport(), document.objects(), {}));
    const KM_UUID id = document.objects().addPoint(L"P", {1, 1, 1}).id;
    EXPECT_TRUE(fitViewport(view.viewport(), document.objects(), {}));
    document.objects().setVisible(id, false);
    EXPECT_FALSE(fitViewport(view.viewport(), document.objects(), {}));
}

TEST_F(ViewFitLimitTest, ASinglePointIsSeenFromADistance) {
    document.objects().addPoint(L"P", {3, 4, 5});
    for (const bool turn : {false, true}) {
        const auto fitted = fitViewport(view.viewport(), document.objects(), {.turn = turn});
        ASSERT_TRUE(fitted);
        EXPECT_EQ(fitted.value().TargetPoint(), KM_3dPoint(3, 4, 5));
        EXPECT_GT(fitted.value().TargetDistance(), 0.5);
    }
}

TEST_F(ViewFitLimitTest, ALineAlongTheViewKeepsItsDistance) {
    const KM_3dPoint ends[] = {{-10, 0, 0}, {10, 0, 0}};
    document.objects().addCurve(L"Spike", std::make_unique<KM_PolylineCurve>(ends));
    view.setTargetAndCamera({0, 0, 0}, {5, 0, 0}, true, true);
    const auto fitted = fitViewport(view.viewport(), document.objects(), {});
    ASSERT_TRUE(fitted);
    EXPECT_NEAR(fitted.value().CameraLocation().x, 10.1, 1e-9);
}

} // namespace
} // namespace quarn::test
