#include "tests/zoetrix/fixtures/PlugInFixture.h"
#include "zoetrix/paths/ZoetrixDynamicAccess.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <limits>

namespace {

class FrameAccess : public PlugInFixture {
protected:
    bool viewAt(int frame) { return access().AnimatedViewAtFrame(doc(), record(), frame, camera); }
    bool sunAt(int frame) { return access().AnimatedSunAtFrame(doc(), record(), frame, light); }
    static IQnZoetrixDynamicAccess& access() { return *Zoetrix_QuarnDynamicAccess(); }

    int liveLights() {
        int count = 0;
        for (int i = 0; i < doc().LightTable().LightCount(); ++i)
            count += doc().LightTable()[i].IsDeleted() ? 0 : 1;
        return count;
    }

    KM_Viewport camera;
    KM_Light light;
};

KM_Light lightShining(const KM_3dVector& direction) {
    KM_Light light;
    light.SetStyle(KM_LightStyle::world_directional);
    light.SetDirection(direction);
    return light;
}

/// The up of a camera that looks along +Y, rolled by 30 degrees.
const KM_3dVector up_at_30_degrees(0.5, 0.0, std::sqrt(0.75));

} // namespace

TEST_F(FrameAccess, FrameNTakesElementNMinusOne) {
    setUpCameraFrames(3);
    for (int frame = 1; frame <= 3; ++frame) {
        ASSERT_TRUE(viewAt(frame));
        EXPECT_TRUE(near(camera.CameraLocation(), cameraOfFrame(frame - 1), 0.0));
        EXPECT_TRUE(near(camera.TargetPoint(), targetOfFrame(frame - 1), 0.0));
    }
}

TEST_F(FrameAccess, FramesOutsideTheShorterListFail) {
    setUpCameraFrames(3);
    record().TargetPoints().SetCount(2);
    for (const int frame :
         {0, -1, 3, 4, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()})
        EXPECT_FALSE(viewAt(frame)) << frame;
    EXPECT_TRUE(viewAt(2));

    setUpSunFrames(3);
    record().CameraPoints().SetCount(2);
    for (const int frame :
         {0, -1, 3, 4, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()})
        EXPECT_FALSE(sunAt(frame)) << frame;
    EXPECT_TRUE(sunAt(2));
}

TEST_F(FrameAccess, AFrameCountUnlikeTheListsIsNotAsked) {
    for (const int count : {0, -7, 1, 100, std::numeric_limits<int>::max()}) {
        setUpCameraFrames(3);
        record().SetFrameCount(count);
        EXPECT_TRUE(viewAt(3)) << count;
        EXPECT_FALSE(viewAt(4)) << count;
        setUpSunFrames(3);
        record().SetFrameCount(count);
        EXPECT_TRUE(sunAt(3)) << count;
        EXPECT_FALSE(sunAt(4)) << count;
    }
}

TEST_F(FrameAccess, ACurveThatCannotBeDividedSoOftenLeavesTheStoredFrames) {
    importObj("v 0 0 0\nv 10 0 0\no rail\nl 1 2\n");
    setUpCameraFrames(2);
    record().SetCaptureType(KM_3dmAnimationProperties::flythrough);
    record().SetCameraPathId(objectId(L"rail"));
    for (const int count : {0, -3, std::numeric_limits<int>::min()}) {
        record().SetFrameCount(count);
        ASSERT_TRUE(viewAt(2)) << count;
        EXPECT_TRUE(near(camera.CameraLocation(), cameraOfFrame(1), 0.0)) << count;
    }
}

TEST_F(FrameAccess, ACaptureTypeOutOfRangeIsACameraAnimation) {
    setUpCameraFrames(2);
    for (const int type : {-1, 6, 17, std::numeric_limits<int>::max()}) {
        record().SetCaptureType(static_cast<KM_3dmAnimationProperties::CaptureTypes>(type));
        ASSERT_TRUE(viewAt(2)) << type;
        EXPECT_TRUE(near(camera.CameraLocation(), cameraOfFrame(1), 0.0));
        EXPECT_FALSE(sunAt(2)) << type;
    }
}

TEST_F(FrameAccess, AFrameOfALongTurntableTakesAsLongAsOneOfAShortOne) {
    const auto fastest = [this](int frames) {
        setUpCameraFrames(frames);
        auto best = std::chrono::steady_clock::duration::max();
        for (int round = 0; round < 50; ++round) {
            const auto start = std::chrono::steady_clock::now();
            EXPECT_TRUE(viewAt(frames - round));
            best = std::min(best, std::chrono::steady_clock::now() - start);
        }
        return best;
    };
    // A copy of the record would take thousands of times as long.
    EXPECT_LT(fastest(1'000'000), 100 * fastest(100));
}

TEST_F(FrameAccess, ViewNameIsTrimmedAndFoundInAnyCase) {
    setUpCameraFrames(2);
    record().SetViewportName(L"  fRONT\t");
    ASSERT_TRUE(viewAt(1));
    EXPECT_TRUE(camera.IsParallelProjection());
}

TEST_F(FrameAccess, BlankAndUnknownViewNamesFailForBothKinds) {
    for (const wchar_t* name : {L"", L"  \t", L"Back"}) {
        setUpCameraFrames(2);
        record().SetViewportName(name);
        EXPECT_FALSE(viewAt(1));
        setUpSunFrames(2);
        record().SetViewportName(name);
        EXPECT_FALSE(sunAt(1));
    }
}

TEST_F(FrameAccess, CameraInItsTargetFails) {
    setUpCameraFrames(2);
    record().TargetPoints()[1] = record().CameraPoints()[1];
    EXPECT_TRUE(viewAt(1));
    EXPECT_FALSE(viewAt(2));
}

TEST_F(FrameAccess, FrameWhoseCameraCannotBePlacedFails) {
    setUpCameraFrames(5);
    record().CameraPoints()[0] = KM_3dPoint::UnsetPoint;
    record().TargetPoints()[1] = KM_3dPoint::UnsetPoint;
    record().CameraPoints()[2].x = std::numeric_limits<double>::quiet_NaN();
    // A camera that is rolled by 30 degrees takes no direction along its rolled up.
    KM_Viewport rolled = view(L"Perspective").MainViewport().VP();
    ASSERT_TRUE(rolled.SetCameraDirection({0.0, 1.0, 0.0}));
    ASSERT_TRUE(rolled.SetCameraUp(up_at_30_degrees));
    ASSERT_TRUE(view(L"Perspective").MainViewport().SetVP(rolled, true, true));
    record().CameraPoints()[3] = KM_3dPoint::Origin;
    record().TargetPoints()[3] = KM_3dPoint::Origin + 5.0 * rolled.CameraY();
    for (int frame = 1; frame <= 4; ++frame)
        EXPECT_FALSE(viewAt(frame)) << frame;
    EXPECT_TRUE(viewAt(5));
}

TEST_F(FrameAccess, SunStudiesNeverMoveTheCamera) {
    setUpSunFrames(2);
    for (const auto type :
         {KM_3dmAnimationProperties::one_day_sun, KM_3dmAnimationProperties::seasonal_sun}) {
        record().SetCaptureType(type);
        EXPECT_FALSE(viewAt(1));
        EXPECT_TRUE(sunAt(1));
    }
}

TEST_F(FrameAccess, CameraAnimationsNeverLightTheSun) {
    setUpCameraFrames(2);
    light = lightShining({1.0, 2.0, 3.0});
    const KM_Light before = light;
    for (const auto type :
         {KM_3dmAnimationProperties::turntable, KM_3dmAnimationProperties::path,
          KM_3dmAnimationProperties::flythrough, KM_3dmAnimationProperties::none}) {
        record().SetCaptureType(type);
        for (const int frame : {1, 2})
            EXPECT_FALSE(sunAt(frame));
    }
    EXPECT_TRUE(before == light);
}

TEST_F(FrameAccess, SunShinesFromItsPointAsFarAsItsTarget) {
    setUpSunFrames(1);
    record().CameraPoints()[0] = KM_3dPoint(0.0, 60.0, 80.0);
    light.SetIntensity(0.25);
    ASSERT_TRUE(sunAt(1));
    EXPECT_EQ(7, static_cast<int>(light.Style()));
    EXPECT_TRUE(near(light.Location(), KM_3dPoint(0.0, 60.0, 80.0), 0.0));
    EXPECT_TRUE(near(light.Direction(), KM_3dVector(0.0, -60.0, -80.0), 0.0));
    EXPECT_EQ(100.0, light.Direction().Length());
    EXPECT_EQ(0.25, light.Intensity());
}

TEST_F(FrameAccess, NothingButTheResultChanges) {
    importObj("v 0 0 0\nv 10 0 0\no rail\nl 1 2\n");
    setUpCameraFrames(2);
    record().SetCaptureType(KM_3dmAnimationProperties::flythrough);
    record().SetCameraPathId(objectId(L"rail"));
    const KM_Viewport before = view(L"Perspective").MainViewport().VP();
    ASSERT_TRUE(viewAt(2));
    EXPECT_TRUE(near(camera.CameraLocation(), KM_3dPoint(5.0, 0.0, 0.0), 1e-6));
    EXPECT_TRUE(near(record().CameraPoints()[1], cameraOfFrame(1), 0.0));
    EXPECT_TRUE(before == view(L"Perspective").MainViewport().VP());
    EXPECT_FALSE(isHidden(L"rail"));
}

TEST_F(FrameAccess, PathIsRefreshedOnlyWhenBothOfItsCurvesAreNamed) {
    importObj("v 0 0 0\nv 10 0 0\nv 0 0 5\nv 0 4 5\no rail\nl 1 2\no gaze\nl 3 4\n");
    setUpCameraFrames(2);
    record().SetCaptureType(KM_3dmAnimationProperties::path);
    record().SetCameraPathId(objectId(L"rail"));
    ASSERT_TRUE(viewAt(2));
    EXPECT_TRUE(near(camera.CameraLocation(), cameraOfFrame(1), 0.0));
    record().SetCameraPathId(KM_nil_uuid);
    record().SetTargetPathId(objectId(L"gaze"));
    ASSERT_TRUE(viewAt(2));
    EXPECT_TRUE(near(camera.TargetPoint(), targetOfFrame(1), 0.0));
    record().SetCameraPathId(objectId(L"rail"));
    ASSERT_TRUE(viewAt(2));
    EXPECT_TRUE(near(camera.CameraLocation(), KM_3dPoint(10.0, 0.0, 0.0), 1e-6));
    EXPECT_TRUE(near(camera.TargetPoint(), KM_3dPoint(0.0, 4.0, 5.0), 1e-6));
}

TEST_F(FrameAccess, SunStudyThatNamesCurvesTakesItsStoredSuns) {
    importObj("v 0 0 0\nv 10 0 0\nv 0 0 5\nv 0 4 5\no rail\nl 1 2\no gaze\nl 3 4\n");
    for (const auto type :
         {KM_3dmAnimationProperties::one_day_sun, KM_3dmAnimationProperties::seasonal_sun}) {
        setUpSunFrames(2);
        record().SetCaptureType(type);
        record().SetCameraPathId(objectId(L"rail"));
        record().SetTargetPathId(objectId(L"gaze"));
        ASSERT_TRUE(sunAt(2));
        EXPECT_TRUE(near(light.Location(), sunOfFrame(1), 0.0));
        EXPECT_TRUE(near(light.Direction(), KM_3dPoint::Origin - sunOfFrame(1), 0.0));
    }
}

TEST_F(FrameAccess, FrameThatTheRefreshTookAwayFails) {
    importObj("v 0 0 0\nv 10 0 0\no rail\nl 1 2\n");
    setUpCameraFrames(8);
    record().SetCaptureType(KM_3dmAnimationProperties::flythrough);
    record().SetCameraPathId(objectId(L"rail"));
    record().SetFrameCount(3);
    EXPECT_TRUE(viewAt(3));
    EXPECT_FALSE(viewAt(4));
    EXPECT_FALSE(viewAt(8));
}

TEST_F(FrameAccess, ReplacedLightsLeaveOneAndItsIndex) {
    KM_3dmAnimationProperties& props = record();
    KM_Light first = lightShining({0.0, 0.0, -1.0});
    KM_Light second = lightShining({1.0, 0.0, -1.0});
    ReplaceLight(doc(), props, first);
    EXPECT_EQ(1, liveLights());
    const int first_index = props.LightIndex();
    ReplaceLight(doc(), props, second);
    EXPECT_EQ(1, liveLights());
    EXPECT_NE(first_index, props.LightIndex());
    EXPECT_FALSE(doc().LightTable()[props.LightIndex()].IsDeleted());
    EXPECT_TRUE(near(doc().LightTable()[props.LightIndex()].Light().Direction(),
                     KM_3dVector(1.0, 0.0, -1.0), 0.0));
}

TEST_F(FrameAccess, TheFirstLightOfAnAnimationReplacesNone) {
    KM_Light lamp = lightShining({1.0, 0.0, -1.0});
    ASSERT_EQ(0, doc().LightTable().AddLight(lamp, nullptr));
    record().SetLightIndex(-1);
    ReplaceLight(doc(), record(), lamp);
    EXPECT_EQ(1, record().LightIndex());
    EXPECT_EQ(2, liveLights());
}

TEST_F(FrameAccess, StaleLightIndicesDeleteNoLight) {
    KM_Light lamp = lightShining({1.0, 0.0, -1.0});
    CQuarnLightTable& lights = doc().LightTable();
    const int first = lights.AddLight(lamp, nullptr);
    const int deleted = lights.AddLight(lamp, nullptr);
    lights.DeleteLight(deleted, true);
    for (const int stale : {-1, -2, std::numeric_limits<int>::min(), deleted, deleted + 1, 9999,
                            std::numeric_limits<int>::max()}) {
        record().SetLightIndex(stale);
        KM_Light sun = lightShining({0.0, 0.0, -1.0});
        ReplaceLight(doc(), record(), sun);
        EXPECT_FALSE(lights[first].IsDeleted()) << stale;
        EXPECT_EQ(2, liveLights()) << stale;
        EXPECT_EQ(lights.LightCount() - 1, record().LightIndex()) << stale;
        lights.DeleteLight(record().LightIndex(), true);
    }
    EXPECT_EQ(L"", printed()) << "that there was no light to delete is not told";
}

TEST_F(FrameAccess, ASunThatCannotShineTakesTheLastOneAway) {
    KM_Light sun = lightShining({0.0, 0.0, -1.0});
    ReplaceLight(doc(), record(), sun);
    sun.SetDirection(KM_3dVector::ZeroVector);
    ReplaceLight(doc(), record(), sun);
    EXPECT_EQ(0, liveLights());
    EXPECT_EQ(-1, record().LightIndex());
}
