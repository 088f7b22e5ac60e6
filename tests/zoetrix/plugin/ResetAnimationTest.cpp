#include "kelmar/KM_AnimationProperties.h"
#include "tests/zoetrix/fixtures/PlugInFixture.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

namespace {

/// A document with an open curve along X from 0 to 10 and one along Y from 0 to 4, both of one
/// straight piece, so that equal parameter steps are equal lengths.
class ResetAnimation : public PlugInFixture {
protected:
    void SetUp() override {
        importObj("v 0 0 0\nv 10 0 0\nv 0 0 5\nv 0 4 5\no rail\nl 1 2\no gaze\nl 3 4\n");
        props.SetFrameCount(5);
        props.CameraPoints().Append(KM_3dPoint(-1.0, -1.0, -1.0));
        props.TargetPoints().Append(KM_3dPoint(-2.0, -2.0, -2.0));
    }

    KM_3dPointArray camera() const { return props.CameraPoints(); }
    KM_3dPointArray target() const { return props.TargetPoints(); }

    KM_3dmAnimationProperties props;
    const KM_3dPointArray old_camera = {{-1.0, -1.0, -1.0}};
    const KM_3dPointArray old_target = {{-2.0, -2.0, -2.0}};
};

} // namespace

TEST_F(ResetAnimation, FlythroughFollowsItsCurveWithTheTargetOneStepAhead) {
    props.SetCaptureType(KM_3dmAnimationProperties::flythrough);
    props.SetCameraPathId(objectId(L"rail"));
    ASSERT_TRUE(CZoetrixUtilities::ResetAnimation(props));
    ASSERT_EQ(5, camera().Count());
    ASSERT_EQ(5, target().Count());
    for (int k = 0; k < 5; ++k) {
        EXPECT_TRUE(near(camera()[k], KM_3dPoint(2.0 * k, 0.0, 0.0), 1e-6));
        EXPECT_TRUE(near(target()[k], KM_3dPoint(2.0 * (k + 1), 0.0, 0.0), 1e-6));
    }
}

TEST_F(ResetAnimation, FlythroughOfOneFrameLooksFromStartToEnd) {
    props.SetCaptureType(KM_3dmAnimationProperties::flythrough);
    props.SetCameraPathId(objectId(L"rail"));
    props.SetFrameCount(1);
    ASSERT_TRUE(CZoetrixUtilities::ResetAnimation(props));
    EXPECT_EQ(KM_3dPointArray({{0.0, 0.0, 0.0}}), camera());
    EXPECT_EQ(KM_3dPointArray({{10.0, 0.0, 0.0}}), target());
}

TEST_F(ResetAnimation, FlythroughWithoutFramesFailsAndKeepsThePoints) {
    props.SetCaptureType(KM_3dmAnimationProperties::flythrough);
    props.SetCameraPathId(objectId(L"rail"));
    props.SetFrameCount(0);
    EXPECT_FALSE(CZoetrixUtilities::ResetAnimation(props));
    EXPECT_EQ(old_camera, camera());
    EXPECT_EQ(old_target, target());
}

TEST_F(ResetAnimation, FlythroughWhoseCurveIsGoneKeepsThePoints) {
    props.SetCaptureType(KM_3dmAnimationProperties::flythrough);
    props.SetCameraPathId(KM_UuidFromString("11111111-2222-3333-4444-555555555555"));
    EXPECT_TRUE(CZoetrixUtilities::ResetAnimation(props));
    EXPECT_EQ(old_camera, camera());
    EXPECT_EQ(old_target, target());
}

TEST_F(ResetAnimation, PathFollowsEachOfItsCurvesFromEndToEnd) {
    props.SetCaptureType(KM_3dmAnimationProperties::path);
    props.SetCameraPathId(objectId(L"rail"));
    props.SetTargetPathId(objectId(L"gaze"));
    ASSERT_TRUE(CZoetrixUtilities::ResetAnimation(props));
    ASSERT_EQ(5, camera().Count());
    ASSERT_EQ(5, target().Count());
    for (int k = 0; k < 5; ++k) {
        EXPECT_TRUE(near(camera()[k], KM_3dPoint(2.5 * k, 0.0, 0.0), 1e-6));
        EXPECT_TRUE(near(target()[k], KM_3dPoint(0.0, 1.0 * k, 5.0), 1e-6));
    }
}

TEST_F(ResetAnimation, PathKeepsThePointsOfTheCurveThatIsGone) {
    props.SetCaptureType(KM_3dmAnimationProperties::path);
    props.SetTargetPathId(objectId(L"gaze"));
    ASSERT_TRUE(CZoetrixUtilities::ResetAnimation(props));
    EXPECT_EQ(old_camera, camera());
    EXPECT_EQ(5, target().Count());
}

TEST_F(ResetAnimation, PathOfOneFrameKeepsBothLists) {
    props.SetCaptureType(KM_3dmAnimationProperties::path);
    props.SetCameraPathId(objectId(L"rail"));
    props.SetTargetPathId(objectId(L"gaze"));
    props.SetFrameCount(1);
    EXPECT_TRUE(CZoetrixUtilities::ResetAnimation(props));
    EXPECT_EQ(old_camera, camera());
    EXPECT_EQ(old_target, target());
}

TEST_F(ResetAnimation, OtherAnimationsStayAsTheyAre) {
    props.SetCameraPathId(objectId(L"rail"));
    props.SetTargetPathId(objectId(L"gaze"));
    for (const auto type :
         {KM_3dmAnimationProperties::turntable, KM_3dmAnimationProperties::one_day_sun,
          KM_3dmAnimationProperties::seasonal_sun, KM_3dmAnimationProperties::none}) {
        props.SetCaptureType(type);
        EXPECT_TRUE(CZoetrixUtilities::ResetAnimation(props));
        EXPECT_EQ(old_camera, camera());
        EXPECT_EQ(old_target, target());
    }
}
