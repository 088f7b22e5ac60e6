#include "host/session/ViewPicking.h"

#include "engine/display/DisplayMode.h"
#include "host/session/ViewFrame.h"
#include "tests/host/document/DocumentFixtures.h"

#include <cmath>

namespace quarn::test {
namespace {

constexpr int WIDTH_PX = 800;
constexpr int HEIGHT_PX = 600;

class ViewPickingTest : public DocumentTest {
protected:
    void SetUp() override {
        for (const auto& each : document.views())
            ASSERT_TRUE(setFrameSize(each->face(), WIDTH_PX, HEIGHT_PX));
        look(view, {0.0, 0.0, 0.0}, {0.0, -20.0, 0.0});
    }

    void look(ViewState& at, const KM_3dPoint& target, const KM_3dVector& direction) {
        ASSERT_TRUE(at.setTargetAndCamera(target, target + direction, true, true));
    }

    DocumentObject& box(const wchar_t* name, const KM_3dPoint& low, const KM_3dPoint& high) {
        return document.objects().addMesh(name, {boxMesh(low, high)});
    }

    DocumentObject& line(const wchar_t* name, const KM_3dPoint& from, const KM_3dPoint& to) {
        const KM_3dPoint ends[] = {from, to};
        return document.objects().addCurve(name, std::make_unique<KM_PolylineCurve>(ends));
    }

    /// Where a point is seen, moved by some pixels.
    std::pair<double, double> seen(const ViewState& in, const KM_3dPoint& point,
                                   double right_px = 0, double down_px = 0) {
        double x = 0.0;
        double y = 0.0;
        EXPECT_TRUE(in.viewport().WorldToScreen(point, &x, &y, nullptr));
        return {x + right_px, y + down_px};
    }

    std::optional<PickedObject> pick(ViewState& in, const KM_3dPoint& point, double right_px = 0,
                                     double down_px = 0) {
        const auto [x, y] = seen(in, point, right_px, down_px);
        return objectAt(in.face(), x, y);
    }

    std::wstring nameAt(ViewState& in, const KM_3dPoint& point, double right_px = 0,
                        double down_px = 0) {
        const auto picked = pick(in, point, right_px, down_px);
        return picked ? std::wstring(picked->name.View()) : L"nothing";
    }

    ViewState& named(const wchar_t* name) { return *document.findView(name); }
};

void expectNear(const std::optional<KM_3dPoint>& point, const KM_3dPoint& expected,
                double tolerance) {
    ASSERT_TRUE(point);
    EXPECT_NEAR(point->x, expected.x, tolerance);
    EXPECT_NEAR(point->y, expected.y, tolerance);
    EXPECT_NEAR(point->z, expected.z, tolerance);
}

// ---- Surfaces

TEST_F(ViewPickingTest, TheNearestSurfaceIsHitWhereItIsSeen) {
    box(L"Far", {-5.0, 4.0, -5.0}, {5.0, 6.0, 5.0});
    const KM_UUID near_id = box(L"Near", {-1.0, -1.0, -1.0}, {1.0, 1.0, 1.0}).id;
    const auto picked = pick(view, {0.5, -1.0, 0.25});
    ASSERT_TRUE(picked);
    EXPECT_EQ(picked->id, near_id);
    EXPECT_STREQ(picked->name.Array(), L"Near");
    expectNear(picked->point, {0.5, -1.0, 0.25}, 1e-9);
    EXPECT_EQ(nameAt(view, {3.0, 4.0, 0.0}), L"Far");
    EXPECT_FALSE(objectAt(view.face(), 1.0, 1.0));
}

TEST_F(ViewPickingTest, WhatIsHiddenOrDeletedIsNotHitAndWhatIsSelectedIsToldSo) {
    const KM_UUID near_id = box(L"Near", {-1.0, -1.0, -1.0}, {1.0, 1.0, 1.0}).id;
    const KM_UUID far_id = box(L"Far", {-5.0, 4.0, -5.0}, {5.0, 6.0, 5.0}).id;
    document.objects().select(far_id);
    EXPECT_FALSE(pick(view, {0.0, -1.0, 0.0})->is_selected);
    document.objects().setVisible(near_id, false);
    EXPECT_TRUE(pick(view, {0.0, -1.0, 0.0})->is_selected);
    EXPECT_EQ(nameAt(view, {0.0, -1.0, 0.0}), L"Far");
    document.objects().remove(far_id);
    EXPECT_EQ(nameAt(view, {0.0, -1.0, 0.0}), L"nothing");
}

TEST_F(ViewPickingTest, AnObjectWithoutNameIsCalledByItsId) {
    const KM_UUID id = box(L"", {-1.0, -1.0, -1.0}, {1.0, 1.0, 1.0}).id;
    EXPECT_EQ(pick(view, {0.0, -1.0, 0.0})->name, KM_UuidToString(id));
}

TEST_F(ViewPickingTest, ParallelViewsSeeWhatLiesBehindTheirCamera) {
    ViewState& front = named(L"Front"); // its camera stands at y = -80
    box(L"Behind", {-1.0, -200.0, -1.0}, {1.0, -150.0, 1.0});
    const auto picked = objectAt(front.face(), WIDTH_PX / 2.0 + 1.0, HEIGHT_PX / 2.0);
    ASSERT_TRUE(picked);
    EXPECT_STREQ(picked->name.Array(), L"Behind");
    EXPECT_NEAR(picked->point.y, -200.0, 1e-9);
}

TEST_F(ViewPickingTest, MeshesAreHitWhereTheirTransformsPutThem) {
    const auto mesh = boxMesh({-1.0, -1.0, -1.0}, {1.0, 1.0, 1.0});
    for (const double x : {-4.0, 4.0})
        document.objects().addMesh(x < 0 ? L"Left" : L"Right",
                                   {mesh, nullptr, KM_Xform::Translation({x, 0.0, 0.0})});
    EXPECT_EQ(nameAt(view, {-4.0, -1.0, 0.0}), L"Left");
    EXPECT_EQ(nameAt(view, {4.0, -1.0, 0.0}), L"Right");
    EXPECT_EQ(nameAt(view, {0.0, -1.0, 0.0}), L"nothing");
    expectNear(pick(view, {4.5, -1.0, 0.5})->point, {4.5, -1.0, 0.5}, 1e-6);
}

TEST_F(ViewPickingTest, FarFromTheOriginPointsKeepTheirDigits) {
    const KM_3dPoint middle(1.0e7, -1.0e7, 50.0);
    document.objects().addMesh(L"Far", {boxMesh({-1.0, -1.0, -1.0}, {1.0, 1.0, 1.0}), nullptr,
                                        KM_Xform::Translation(middle - KM_3dPoint::Origin)});
    look(view, middle, {0.0, -20.0, 0.0});
    const KM_3dPoint on_face = middle + KM_3dVector(0.25, -1.0, 0.5);
    const auto picked = pick(view, on_face);
    ASSERT_TRUE(picked);
    expectNear(picked->point, on_face, 1e-6);
    EXPECT_EQ(nameAt(view, middle + KM_3dVector(1.01, -1.0, 0.0)), L"nothing");
    EXPECT_EQ(nameAt(view, middle + KM_3dVector(0.99, -1.0, 0.0)), L"Far");
}

// ---- Lines and points

TEST_F(ViewPickingTest, ACurveIsHitWithinSixPixelsOfWhereItIsSeen) {
    line(L"Path", {-3.0, 0.0, 0.0}, {3.0, 0.0, 0.0});
    EXPECT_EQ(nameAt(view, {1.0, 0.0, 0.0}, 0.0, 5.9), L"Path");
    EXPECT_EQ(nameAt(view, {1.0, 0.0, 0.0}, 0.0, -5.9), L"Path");
    EXPECT_EQ(nameAt(view, {1.0, 0.0, 0.0}, 0.0, 6.1), L"nothing");
    expectNear(pick(view, {1.0, 0.0, 0.0}, 0.0, 3.0)->point, {1.0, 0.0, 0.0}, 1e-9);
    EXPECT_EQ(nameAt(view, {3.0, 0.0, 0.0}, 5.9), L"Path");
    EXPECT_EQ(nameAt(view, {3.0, 0.0, 0.0}, 6.1), L"nothing");
}

TEST_F(ViewPickingTest, OnALineThatLeadsAwayThePointUnderTheMouseIsFound) {
    line(L"Path", {-2.0, -15.0, -1.0}, {2.0, 60.0, -1.0});
    const KM_3dPoint on_line(-2.0 + 4.0 * 0.3, -15.0 + 75.0 * 0.3, -1.0);
    expectNear(pick(view, on_line)->point, on_line, 1e-9);
}

TEST_F(ViewPickingTest, ALineThatPassesTheCameraIsCutOffBehindIt) {
    line(L"Path", {1.0, -60.0, 0.0}, {1.0, 60.0, 0.0});
    EXPECT_EQ(nameAt(view, {1.0, 10.0, 0.0}), L"Path");
    // What lies behind the camera would be seen at the picture's other half, mirrored.
    const auto [x, y] = seen(view, {1.0, 10.0, 0.0});
    EXPECT_FALSE(objectAt(view.face(), WIDTH_PX - x, y));
}

TEST_F(ViewPickingTest, LinesGoBeforeTheSurfaceBehindThemAndAreNotHitThroughOneBeforeThem) {
    box(L"Box", {-2.0, -1.0, -2.0}, {2.0, 1.0, 2.0});
    line(L"Before", {-3.0, -2.0, 0.5}, {3.0, -2.0, 0.5});
    line(L"Behind", {-3.0, 2.0, -1.0}, {3.0, 2.0, -1.0});
    line(L"On it", {-2.0, -1.0, 1.5}, {2.0, -1.0, 1.5});
    EXPECT_EQ(nameAt(view, {0.0, -2.0, 0.5}), L"Before");
    EXPECT_EQ(nameAt(view, {0.0, 2.0, -1.0}), L"Box");
    EXPECT_EQ(nameAt(view, {0.5, -1.0, 1.5}), L"On it");
    EXPECT_EQ(nameAt(view, {2.9, 2.0, -1.0}), L"Behind") << "beside the box";
}

TEST_F(ViewPickingTest, WhereLinesAreSeenThroughSurfacesTheyAreHitThroughThem) {
    box(L"Box", {-2.0, -1.0, -2.0}, {2.0, 1.0, 2.0});
    line(L"Behind", {-3.0, 2.0, -1.0}, {3.0, 2.0, -1.0});
    ASSERT_TRUE(view.setDisplayMode(wireframe_mode_id));
    EXPECT_EQ(nameAt(view, {0.0, 2.0, -1.0}), L"Behind");
}

TEST_F(ViewPickingTest, APointGoesBeforeTheCurveThatItLiesOn) {
    line(L"Path", {-3.0, 0.0, 0.0}, {3.0, 0.0, 0.0});
    document.objects().addPoint(L"Mark", {1.0, 0.0, 0.0});
    EXPECT_EQ(nameAt(view, {1.0, 0.0, 0.0}, 4.0), L"Mark");
    EXPECT_EQ(nameAt(view, {1.0, 0.0, 0.0}, 9.0), L"Path");
}

TEST_F(ViewPickingTest, OfTwoCurvesTheOneNearerToTheMouseIsHit) {
    line(L"Upper", {-3.0, 0.0, 0.05}, {3.0, 0.0, 0.05});
    line(L"Lower", {-3.0, 0.0, -0.05}, {3.0, 0.0, -0.05});
    EXPECT_EQ(nameAt(view, {0.0, 0.0, 0.03}), L"Upper");
    EXPECT_EQ(nameAt(view, {0.0, 0.0, -0.03}), L"Lower");
}

// ---- Points for commands

TEST_F(ViewPickingTest, APointIsOnTheNearestSurfaceElseOnTheGround) {
    look(view, {0.0, 0.0, 0.0}, {0.0, -20.0, 15.0});
    box(L"Box", {-1.0, -1.0, 0.0}, {1.0, 1.0, 2.0});
    const auto [x, y] = seen(view, {0.5, 0.25, 2.0});
    expectNear(pointAt(view.face(), x, y), {0.5, 0.25, 2.0}, 1e-9);
    const auto [ground_x, ground_y] = seen(view, {4.0, 3.0, 0.0});
    expectNear(pointAt(view.face(), ground_x, ground_y), {4.0, 3.0, 0.0}, 1e-9);
}

TEST_F(ViewPickingTest, AboveTheHorizonThereIsNoPoint) {
    look(view, {0.0, 0.0, 5.0}, {0.0, -20.0, 0.0});
    EXPECT_FALSE(pointAt(view.face(), WIDTH_PX / 2.0, HEIGHT_PX / 2.0 - 50.0));
    EXPECT_FALSE(pointAt(view.face(), WIDTH_PX / 2.0, HEIGHT_PX / 2.0)) << "on the horizon";
    EXPECT_TRUE(pointAt(view.face(), WIDTH_PX / 2.0, HEIGHT_PX / 2.0 + 50.0));
}

TEST_F(ViewPickingTest, AlongAnAxisAPointIsOnThePlaneOfTheTarget) {
    ViewState& front = named(L"Front");
    look(front, {1.0, 2.0, 3.0}, {0.0, -30.0, 0.0});
    const auto [x, y] = seen(front, {4.0, 2.0, 6.0});
    expectNear(pointAt(front.face(), x, y), {4.0, 2.0, 6.0}, 1e-9);
    ViewState& top = named(L"Top");
    const auto [top_x, top_y] = seen(top, {4.0, -5.0, 0.0});
    expectNear(pointAt(top.face(), top_x, top_y), {4.0, -5.0, 0.0}, 1e-9);
}

TEST_F(ViewPickingTest, AParallelViewAlongNoAxisMeetsTheGroundAlsoBehindItsCamera) {
    ViewState& slanted = named(L"Front");
    look(slanted, {0.0, 0.0, -50.0}, {0.0, -10.0, 10.0}); // the camera stands at z = -40
    const auto [x, y] = seen(slanted, {2.0, -50.0, 0.0});
    expectNear(pointAt(slanted.face(), x, y), {2.0, -50.0, 0.0}, 1e-9);
}

TEST_F(ViewPickingTest, AClosedViewAnswersNothing) {
    box(L"Box", {-1.0, -1.0, -1.0}, {1.0, 1.0, 1.0});
    ASSERT_TRUE(document.closeView(L"Perspective"));
    EXPECT_FALSE(objectAt(view.face(), WIDTH_PX / 2.0, HEIGHT_PX / 2.0));
    EXPECT_FALSE(pointAt(view.face(), WIDTH_PX / 2.0, HEIGHT_PX / 2.0 + 10.0));
}

} // namespace
} // namespace quarn::test
