// The cameras that are exported, beside those that a recording drew its frames with.
#include "tests/host/share/camera/CameraFixture.h"

namespace quarn::test {
namespace {

class RecordedCameras : public CameraFixture {
protected:
    void expectSameAsRecorded() {
        const KM_Viewport before = perspective().viewport();
        const Json track = exportedJson();
        EXPECT_TRUE(perspective().viewport() == before) << "exporting moves no view";
        expectCameras(recorded(), track);
    }
};

constexpr const char* RAIL = "-8 -6 3\n0 -9 4\n8 -6 3\n9 4 5\n";

TEST_F(RecordedCameras, OfATurntableAreThoseThatFramesAreDrawnWith) {
    runAll({L"FitView Turn=Yes _Enter",
            L"SetTurntableAnimation 5 _AntiClockwise _png _Wireframe _Enter _Enter"});
    expectSameAsRecorded();
}

TEST_F(RecordedCameras, OfAParallelViewHaveItsExtent) {
    runAll({L"Camera Parallel=Yes _Enter", L"FitView _Enter",
            L"SetTurntableAnimation 4 _Clockwise _png _Wireframe _Enter _Enter"});
    expectSameAsRecorded();
}

TEST_F(RecordedCameras, FollowCurvesToWhereTheyAreNow) {
    makeCurve("Walk", RAIL);
    runAll({L"SetFlythroughAnimation Walk 5 _png _Wireframe _Enter _Enter"});
    const Json as_set_up = exportedJson();
    makeCurve("Walk", "-8 -6 9\n0 -9 8\n8 -6 7\n", true);
    const Json moved = exportedJson();
    EXPECT_NE(as_set_up.at("frames"), moved.at("frames"));
    EXPECT_EQ(pointOf(moved["frames"][0]["place"]).z, 9.0);
    expectSameAsRecorded();
}

TEST_F(RecordedCameras, OfAPathFollowBothOfItsCurves) {
    makeCurve("Rail", RAIL);
    makeCurve("Gaze", "0 0 0\n0 2 1\n1 2 0\n");
    runAll({L"SetPathAnimation Rail Gaze 6 _png _Wireframe _Enter _Enter"});
    makeCurve("Gaze", "0 0 5\n0 2 6\n1 2 5\n", true);
    expectSameAsRecorded();
}

TEST_F(RecordedCameras, ThatPassAboveTheirTargetCarryTheirUpOver) {
    setUpCameras({{-6, 0, 8}, {-3, 0, 8}, {0, 0, 8}, {0, 0, 9}, {0.5, 3, 8}, {0, 0, -4}});
    perspective().setTargetAndCamera(KM_3dPoint::Origin, {-6, 0, 8}, true, true);
    const Json track = exportedJson();
    EXPECT_TRUE(alike(pointOf(track["frames"][2]["up"]), {1, 0, 0}, 1e-12))
        << "it came from -X, and leans over forward";
    expectSameAsRecorded();
}

TEST_F(RecordedCameras, ThatBeginStraightAboveFollowTheViewThatTheyBeginIn) {
    setUpCameras({{0, 0, 8}, {0, 0, 7}});
    for (const KM_3dPoint& place : {KM_3dPoint(-6, 0, 8), KM_3dPoint(3, 4, 8)}) {
        perspective().setTargetAndCamera(KM_3dPoint::Origin, place, true, true);
        expectSameAsRecorded();
    }
}

TEST_F(RecordedCameras, ThatCannotBePlacedStayWhereTheFrameBeforeHadThem) {
    setUpCameras({{-6, 0, 8}, {0, 0, 0}, {HUGE_VAL, 0, 8}, {6, 0, 8}});
    const Json track = exportedJson();
    EXPECT_EQ(track["frames"][1]["place"], track["frames"][0]["place"]);
    EXPECT_EQ(track["frames"][2]["place"], track["frames"][0]["place"]);
    expectSameAsRecorded();
}

TEST_F(RecordedCameras, LevelAViewWithATiltedHorizon) {
    KM_Viewport tilted = perspective().viewport();
    ASSERT_TRUE(tilted.SetCameraUp({0.5, 0.1, 1.0}));
    perspective().setViewport(tilted, true, true);
    setUpCameras({{0, 0, 8}, {-6, 0, 8}, {0, -6, 8}});
    expectSameAsRecorded();
}

TEST_F(RecordedCameras, OfASunStudyStandStillUnderTheRecordsSun) {
    runAll({L"SetOneDaySunAnimation 40 20 10 21 6 2026 9 0 12 0 60 _png _RenderedViewport _Enter "
            L"_Enter"});
    const Json track = exportedJson();
    ASSERT_EQ(track["frames"].size(), 4U);
    for (int k = 0; k < 4; ++k) {
        const KM_3dPoint sun = record().CameraPoints()[k];
        const Json& told = track["frames"][static_cast<std::size_t>(k)]["sun"];
        EXPECT_TRUE(alike(sun, pointOf(told["direction"]), 1e-12)) << k;
        EXPECT_EQ(told["time"], "2026-06-21T" + std::string(k ? "1" : "0") + "9012"[k] + ":00:00");
        EXPECT_EQ(told["zone"], "UTC+1");
        EXPECT_NEAR(std::sin(told["altitude_deg"].get<double>() * KM_PI / 180), sun.z, 1e-12);
    }
    expectSameAsRecorded();
}

TEST_F(RecordedCameras, OfRenderedPicturesHaveTheirShape) {
    runAll({L"Camera Parallel=Yes _Enter", L"FitView _Enter",
            L"RenderSettings Size 60 20 PreviewSamples 1 _Enter",
            L"SetTurntableAnimation 1 _Clockwise _png _RenderPreview _Enter _Enter"});
    const Json track = exportedJson();
    EXPECT_EQ(track["width_px"], 60);
    EXPECT_NEAR(track["width"].get<double>(), 3.0 * track["height"].get<double>(), 1e-9);
}

TEST_F(RecordedCameras, OfOneFrameIsThatFrame) {
    runAll({L"SetTurntableAnimation 1 _Clockwise _png _Wireframe _Enter _Enter"});
    expectSameAsRecorded();
}

} // namespace
} // namespace quarn::test
