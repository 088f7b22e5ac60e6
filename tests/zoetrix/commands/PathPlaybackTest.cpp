#include "tests/zoetrix/fixtures/PathFixture.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <algorithm>

using testing::Each;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

namespace {

/// Which of the curves were hidden at a moment.
struct Hidden {
    bool rail;
    bool gaze;
    friend bool operator==(const Hidden&, const Hidden&) = default;
};

constexpr Hidden none{false, false};
constexpr Hidden only_rail{true, false};
constexpr Hidden both{true, true};

class PathPlayback : public PathFixture {
protected:
    void SetUp() override {
        PathFixture::SetUp();
        ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 64 48"));
        record().SetFolderName(wide(folder.path() / "frames"));
    }

    /// Runs the command. @return what was hidden at every moment that it waited
    std::vector<Hidden> watch(const wchar_t* command) {
        std::vector<Hidden> seen;
        front_end.while_waiting = [&] { seen.push_back({isHidden(L"rail"), isHidden(L"gaze")}); };
        EXPECT_EQ(CQuarnCommand::success, run(command)) << KM_wString(command).ToUtf8();
        front_end.while_waiting = nullptr;
        return seen;
    }

    /// Plays all. @return where the camera was whenever it waited
    std::vector<KM_3dPoint> camerasPlayed() {
        std::vector<KM_3dPoint> cameras;
        front_end.while_waiting = [&] {
            cameras.push_back(view(L"Perspective").MainViewport().VP().CameraLocation());
        };
        EXPECT_EQ(CQuarnCommand::success, run(L"PlayAnimation"));
        front_end.while_waiting = nullptr;
        return cameras;
    }

    Hidden now() { return {isHidden(L"rail"), isHidden(L"gaze")}; }
};

bool passes(const std::vector<KM_3dPoint>& cameras, const KM_3dPoint& place) {
    return std::ranges::any_of(
        cameras, [&](const KM_3dPoint& camera) { return camera.DistanceTo(place) < 1e-9; });
}

} // namespace

TEST_F(PathPlayback, PathHidesBothCurvesWhileItPlaysAndShowsThemAgain) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"gaze", L"3"));
    EXPECT_EQ(none, now());
    const std::vector<Hidden> seen = watch(L"PlayAnimation");
    EXPECT_GE(seen.size(), 3U);
    EXPECT_THAT(seen, Each(both));
    EXPECT_EQ(none, now());
}

TEST_F(PathPlayback, FlythroughHidesItsOwnCurveOnlyWhileItPlays) {
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"rail", L"3"));
    const std::vector<Hidden> seen = watch(L"PlayAnimation");
    EXPECT_GE(seen.size(), 3U);
    EXPECT_THAT(seen, Each(only_rail));
    EXPECT_EQ(none, now());
}

TEST_F(PathPlayback, SingleFramesHideTheCurvesToo) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"gaze", L"3"));
    for (const wchar_t* command : {L"ViewFirstFrame", L"ViewNextFrame", L"ViewLastFrame",
                                   L"ViewPreviousFrame", L"ViewFrameNumber 2"}) {
        const std::vector<Hidden> seen = watch(command);
        EXPECT_FALSE(seen.empty());
        EXPECT_THAT(seen, Each(both));
        EXPECT_EQ(none, now());
    }
}

TEST_F(PathPlayback, RecordingHidesTheCurvesOfBothKinds) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"gaze", L"3"));
    std::vector<Hidden> seen = watch(L"RecordAnimation _Enter");
    EXPECT_GE(seen.size(), 3U);
    EXPECT_THAT(seen, Each(both));
    EXPECT_EQ(none, now());
    EXPECT_EQ(3, record().Images().Count());

    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"rail", L"3"));
    seen = watch(L"RecordAnimation _Enter");
    EXPECT_GE(seen.size(), 3U);
    EXPECT_THAT(seen, Each(only_rail));
    EXPECT_EQ(none, now());
    EXPECT_EQ(3, record().Images().Count());
}

TEST_F(PathPlayback, RecordingThatIsInterruptedShowsTheCurvesAgain) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"gaze", L"5"));
    front_end.while_waiting = [this] { front_end.interrupt(); };
    run(L"RecordAnimation _Enter");
    EXPECT_LT(record().Images().Count(), 5);
    EXPECT_EQ(none, now());
}

TEST_F(PathPlayback, CurveThatWasHiddenBeforeStaysHidden) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"gaze", L"3"));
    ASSERT_EQ(CQuarnCommand::success, run(L"_-Hide gaze _Enter"));
    EXPECT_THAT(watch(L"PlayAnimation"), Each(both));
    EXPECT_EQ((Hidden{false, true}), now());
}

TEST_F(PathPlayback, TargetThatIsAPointIsHiddenToo) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"spot", L"3"));
    std::vector<bool> spot_hidden;
    front_end.while_waiting = [&] { spot_hidden.push_back(isHidden(L"spot")); };
    ASSERT_EQ(CQuarnCommand::success, run(L"PlayAnimation"));
    front_end.while_waiting = nullptr;
    EXPECT_FALSE(spot_hidden.empty());
    EXPECT_THAT(spot_hidden, Each(true));
    EXPECT_FALSE(isHidden(L"spot"));
}

TEST_F(PathPlayback, EditedCurveIsFollowedAtTheNextPlay) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"spot", L"3"));
    EXPECT_TRUE(passes(camerasPlayed(), {5.0, 0.0, 1.0}));
    editCurve(L"rail", KM_LineCurve({0.0, -8.0, 1.0}, {10.0, -8.0, 1.0}));
    const std::vector<KM_3dPoint> cameras = camerasPlayed();
    EXPECT_TRUE(passes(cameras, {5.0, -8.0, 1.0}));
    EXPECT_FALSE(passes(cameras, {5.0, 0.0, 1.0}));
}

TEST_F(PathPlayback, EditedCurveIsFlownAtTheNextPlay) {
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"rail", L"4"));
    EXPECT_TRUE(passes(camerasPlayed(), {2.5, 0.0, 1.0}));
    editCurve(L"rail", unevenCurve());
    const std::vector<KM_3dPoint> cameras = camerasPlayed();
    for (int k = 0; k < 4; ++k)
        EXPECT_TRUE(passes(cameras, uneven_points[k])) << k;
    EXPECT_FALSE(passes(cameras, {2.5, 0.0, 1.0}));
}

TEST_F(PathPlayback, CurveThatIsGoneIsPlayedAsItWasSetUp) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"spot", L"3"));
    remove(L"rail");
    EXPECT_TRUE(passes(camerasPlayed(), {5.0, 0.0, 1.0}));
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"gaze", L"4"));
    remove(L"gaze");
    EXPECT_TRUE(passes(camerasPlayed(), {0.0, 1.0, 5.0}));
}

TEST_F(PathPlayback, FlythroughOfOneFrameIsFollowedAndAPathOfOneFrameIsNot) {
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"rail", L"1"));
    editCurve(L"rail", KM_LineCurve({0.0, -8.0, 1.0}, {10.0, -8.0, 1.0}));
    EXPECT_TRUE(passes(camerasPlayed(), {0.0, -8.0, 1.0}));
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"spot", L"1"));
    editCurve(L"rail", KM_LineCurve({0.0, 0.0, 1.0}, {10.0, 0.0, 1.0}));
    const std::vector<KM_3dPoint> cameras = camerasPlayed();
    EXPECT_TRUE(passes(cameras, {0.0, -8.0, 1.0}));
    EXPECT_FALSE(passes(cameras, {0.0, 0.0, 1.0}));
}

TEST_F(PathPlayback, CurveThatCanBeEvaluatedNoMoreKeepsThePoints) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"gaze", L"3"));
    const KM_3dPointArray cameras = record().CameraPoints();
    editCurve(L"rail", curveWithoutPoints());
    EXPECT_TRUE(CZoetrixUtilities::ResetAnimation(record()));
    EXPECT_EQ(cameras, record().CameraPoints());

    editCurve(L"rail", KM_LineCurve({0.0, 0.0, 1.0}, {10.0, 0.0, 1.0}));
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"rail", L"3"));
    const KM_3dPointArray flown = record().CameraPoints();
    editCurve(L"rail", curveWithoutPoints());
    EXPECT_FALSE(CZoetrixUtilities::ResetAnimation(record()));
    EXPECT_EQ(flown, record().CameraPoints());
}

TEST_F(PathPlayback, FramesWithoutAPlaceLeaveTheViewWhereItIs) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"gaze", L"5"));
    editCurve(L"rail", curveWithHoleAt(2));
    // Of the five places one is missing now, so that the last frame has no camera.
    const std::vector<KM_3dPoint> cameras = camerasPlayed();
    EXPECT_TRUE(passes(cameras, {10.0, 0.0, 0.0}));
    EXPECT_TRUE(passes(cameras, {30.0, 0.0, 0.0}));
    ASSERT_FALSE(cameras.empty());
    EXPECT_TRUE(near(cameras.back(), KM_3dPoint(40.0, 0.0, 0.0), 1e-9));
    EXPECT_EQ(none, now());
}
