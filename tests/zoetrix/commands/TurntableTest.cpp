#include "tests/zoetrix/fixtures/TurntableFixture.h"

#include <cmath>

using testing::HasSubstr;

namespace {

class Turntable : public TurntableFixture {
protected:
    static KM_3dmAnimationProperties marked() {
        KM_3dmAnimationProperties props;
        props.SetFrameCount(7);
        props.SetHtmlFilename(L"Walk");
        props.SetCaptureMethod(L"Shaded");
        return props;
    }

    /// That the record still is the one of marked().
    void expectRecordUntouched() {
        EXPECT_EQ(KM_3dmAnimationProperties::none, record().CaptureType());
        EXPECT_EQ(7, record().FrameCount());
        EXPECT_EQ(1, record().CurrentFrame());
        EXPECT_EQ(L"jpg", record().FileExtension().View());
        EXPECT_TRUE(record().CameraPoints().IsEmpty());
        EXPECT_TRUE(record().TargetPoints().IsEmpty());
    }

    /// That the record holds four frames, the first a quarter of the turn to the right of the eye.
    void expectAnticlockwise() {
        ASSERT_EQ(4, record().CameraPoints().Count());
        EXPECT_TRUE(near(record().CameraPoints()[0], KM_3dPoint(6.0, -3.0, 3.0), 1e-12));
    }
};

} // namespace

TEST_F(Turntable, CameraTravelsOnceAroundAtItsOwnHeightAndEndsWhereItStands) {
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"8", L"_Enter"));
    const KM_3dmAnimationProperties& props = record();
    EXPECT_EQ(KM_3dmAnimationProperties::turntable, props.CaptureType());
    EXPECT_EQ(8, props.FrameCount());
    EXPECT_EQ(0, props.CurrentFrame());
    ASSERT_EQ(8, props.CameraPoints().Count());
    ASSERT_EQ(8, props.TargetPoints().Count());
    for (int k = 0; k < 8; ++k) {
        const KM_3dPoint& camera = props.CameraPoints()[k];
        EXPECT_NEAR(radius, camera.DistanceTo(centre), 1e-12) << k;
        EXPECT_NEAR(3.0, camera.z, 1e-12) << k;
        EXPECT_TRUE(near(props.TargetPoints()[k], target, 0.0)) << k;
    }
    EXPECT_TRUE(near(props.CameraPoints()[7], eye, 0.0));
}

TEST_F(Turntable, RemembersClockwiseAtFirstAndRunsAnticlockwiseSeenFromAbove) {
    // The remembered direction leaves the circle as it was made, which is anticlockwise.
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"_Enter"));
    const KM_3dPointArray points = record().CameraPoints();
    const double quarters[] = {0.5 * KM_PI, KM_PI, 1.5 * KM_PI};
    for (int k = 0; k < 3; ++k)
        EXPECT_NEAR(quarters[k], angleOf(points[k]), 1e-12) << k;
    EXPECT_TRUE(near(points[3], eye, 0.0));
    // (3, 4) turned by a quarter about the centre is (-4, 3).
    EXPECT_TRUE(near(points[0], KM_3dPoint(-2.0, 3.0, 3.0), 1e-12));
}

TEST_F(Turntable, AntiClockwiseTakesTheSamePlacesTheOtherWayRound) {
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"AntiClockwise"));
    const KM_3dPointArray points = record().CameraPoints();
    EXPECT_TRUE(near(points[0], KM_3dPoint(6.0, -3.0, 3.0), 1e-12));
    EXPECT_TRUE(near(points[1], KM_3dPoint(-1.0, -4.0, 3.0), 1e-12));
    EXPECT_TRUE(near(points[2], KM_3dPoint(-2.0, 3.0, 3.0), 1e-12));
    EXPECT_TRUE(near(points[3], eye, 0.0));
}

TEST_F(Turntable, ThreeFramesStandAtThirdsOfTheCirclesParameterNotOfItsAngle) {
    // A quarter of the circle is a rational curve of degree 2 with the weights 1, w, 1, where w is
    // the cosine of 45 degrees. A third of the turn is a third of the second quarter; there, at
    // u = 1/3, the weights are (1-u)^2 = 4/9, 2u(1-u)w = 4w/9 and u^2 = 1/9, so that the place is
    // a times the quarter's begin plus b times its end with
    const double w = std::sqrt(0.5);
    const double a = (4.0 + 4.0 * w) / (5.0 + 4.0 * w);
    const double b = (1.0 + 4.0 * w) / (5.0 + 4.0 * w);
    // From the centre the eye stands at (3, 4), and the quarters begin at (3, 4), (-4, 3), (-3, -4)
    // and (4, -3). Two thirds of the turn are two thirds of the third quarter, which mirrors it.
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"3", L"_Enter"));
    const KM_3dPointArray points = record().CameraPoints();
    ASSERT_EQ(3, points.Count());
    EXPECT_TRUE(
        near(points[0], centre + a * KM_3dVector(-4, 3, 0) + b * KM_3dVector(-3, -4, 0), 1e-12));
    EXPECT_TRUE(
        near(points[1], centre + b * KM_3dVector(-3, -4, 0) + a * KM_3dVector(4, -3, 0), 1e-12));
    EXPECT_TRUE(near(points[2], eye, 0.0));
    // At equal angles the first would be elsewhere.
    EXPECT_GT(std::abs(angleOf(points[0]) - 2.0 * KM_PI / 3.0), 0.01);
}

TEST_F(Turntable, NoFrameIsRepeated) {
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"100", L"_Enter"));
    const KM_3dPointArray points = record().CameraPoints();
    ASSERT_EQ(100, points.Count());
    double before = 0.0;
    for (int k = 0; k < 99; ++k) {
        EXPECT_GT(angleOf(points[k]), before) << k;
        before = angleOf(points[k]);
    }
}

TEST_F(Turntable, LastFrameStandsAtTheCameraForAnyFrameCountAndPlace) {
    for (const KM_3dPoint& place : {KM_3dPoint(0.1, 0.2, 0.3), KM_3dPoint(-1e6, 3.0, 0.7),
                                    KM_3dPoint(1.0 / 3.0, -2.0 / 7.0, 1e-3)}) {
        placeCamera(L"Perspective", place, target);
        for (const wchar_t* frames : {L"2", L"3", L"7", L"361"}) {
            ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(frames, L"_Enter"));
            EXPECT_TRUE(near(*record().CameraPoints().Last(), place, 0.0));
        }
    }
}

TEST_F(Turntable, CameraOnTheOppositeSideOfTheStartStaysOnItsHorizontalCircle) {
    // The circle starts toward +X; this camera stands exactly toward -X.
    placeCamera(L"Perspective", {-3.0, 0.0, 4.0}, {2.0, 0.0, 1.0});
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"_Enter"));
    const KM_3dPointArray points = record().CameraPoints();
    EXPECT_TRUE(near(points[0], KM_3dPoint(2.0, -5.0, 4.0), 1e-12));
    EXPECT_TRUE(near(points[1], KM_3dPoint(7.0, 0.0, 4.0), 1e-12));
    EXPECT_TRUE(near(points[3], KM_3dPoint(-3.0, 0.0, 4.0), 0.0));
}

TEST_F(Turntable, CameraBelowTheTargetCirclesAtItsOwnHeight) {
    placeCamera(L"Perspective", {5.0, 4.0, -7.0}, target);
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"12", L"_Enter"));
    for (int k = 0; k < 12; ++k) {
        EXPECT_NEAR(-7.0, record().CameraPoints()[k].z, 1e-12);
        EXPECT_TRUE(near(record().TargetPoints()[k], target, 0.0));
    }
}

TEST_F(Turntable, OneFrameIsTheCameraItself) {
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"1", L"AntiClockwise"));
    EXPECT_EQ(KM_3dPointArray({eye}), record().CameraPoints());
    EXPECT_EQ(KM_3dPointArray({target}), record().TargetPoints());
}

TEST_F(Turntable, CameraAboveItsTargetFailsAtOnceAndAsksNothing) {
    record() = marked();
    for (const double offset : {0.0, 0.9e-3}) {
        KM_Viewport camera = view(L"Perspective").MainViewport().VP();
        ASSERT_TRUE(camera.SetCameraDirection({0.0, 1.0, -5.0}));
        ASSERT_TRUE(camera.SetCameraLocation({2.0, offset, 9.0}));
        ASSERT_TRUE(camera.SetTargetPoint({2.0, 0.0, 0.0}));
        ASSERT_TRUE(view(L"Perspective").MainViewport().SetVP(camera, true, true));
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::failure, run(L"SetTurntableAnimation"));
        EXPECT_THAT(printed(), HasSubstr(L"Failed to create valid camera path in this view. "
                                         L"Nothing done\n"));
        EXPECT_TRUE(front_end.questions().empty());
        expectRecordUntouched();
    }
}

TEST_F(Turntable, RadiusOfExactlyTheToleranceIsEnough) {
    ASSERT_EQ(0.001, doc().AbsoluteTolerance());
    KM_Viewport camera = view(L"Perspective").MainViewport().VP();
    ASSERT_TRUE(camera.SetCameraDirection({0.0, 1.0, -5.0}));
    ASSERT_TRUE(camera.SetCameraLocation({0.0, 0.001, 9.0}));
    ASSERT_TRUE(camera.SetTargetPoint({0.0, 0.0, 0.0}));
    ASSERT_TRUE(view(L"Perspective").MainViewport().SetVP(camera, true, true));
    EXPECT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"_Enter"));
}

TEST_F(Turntable, RadiusIsMeasuredAgainstTheToleranceOfTheDocument) {
    // A model of a thousandth of a unit has a tolerance of 10^-6 of its diagonal.
    importObj("v 0 0 0\nv 0.001 0 0\nv 0.001 0.001 0.001\nf 1 2 3\n");
    const double tolerance = 1e-9 * std::sqrt(3.0);
    ASSERT_NEAR(doc().AbsoluteTolerance(), tolerance, 1e-15);
    placeCamera(L"Perspective", {0.0, 1e-6, 1e-6}, {0.0, 0.0, 0.0});
    EXPECT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"_Enter"));
    placeCamera(L"Perspective", {0.0, 0.9 * tolerance, 1e-6}, {0.0, 0.0, 0.0});
    EXPECT_EQ(CQuarnCommand::failure, run(L"SetTurntableAnimation"));
}

TEST_F(Turntable, ViewWithoutTargetFails) {
    KM_Viewport camera = view(L"Perspective").MainViewport().VP();
    ASSERT_TRUE(camera.SetTargetPoint(KM_3dPoint::UnsetPoint));
    ASSERT_TRUE(view(L"Perspective").MainViewport().SetVP(camera, true, true));
    EXPECT_EQ(CQuarnCommand::failure, run(L"SetTurntableAnimation"));
}

TEST_F(Turntable, PromptsHaveTheirTextsAndDefaults) {
    record().SetFrameCount(42);
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"_Enter", L"_Enter"));
    ASSERT_EQ(6U, front_end.questions().size());
    const quarn::Question& frames = front_end.questions()[0];
    EXPECT_EQ(L"Number of frames", frames.prompt.View());
    EXPECT_EQ(L"42", frames.default_answer->View());
    const quarn::Question& direction = front_end.questions()[1];
    EXPECT_EQ(L"Direction", direction.prompt.View());
    EXPECT_EQ(L"Clockwise", direction.default_answer->View());
    EXPECT_TRUE(direction.accepts_nothing);
    ASSERT_EQ(2U, direction.options.size());
    EXPECT_EQ(L"Clockwise", direction.options[0].english_name.View());
    EXPECT_EQ(L"AntiClockwise", direction.options[1].english_name.View());
    EXPECT_EQ(42, record().FrameCount());
}

TEST_F(Turntable, BadFrameCountsEndItWithAMessage) {
    record() = marked();
    for (const wchar_t* frames : {L"0", L"-3", L"many", L"1.5", L"99999999999", L"_Cancel"}) {
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::cancel,
                  run(KM_wString(L"SetTurntableAnimation ") + frames + L" _Enter"));
        EXPECT_THAT(printed(), HasSubstr(L"Invalid number of frames. Nothing done\n"));
        expectRecordUntouched();
    }
}

TEST_F(Turntable, ADirectionThatIsNoneIsToldAndTheOneThatIsRememberedIsTaken) {
    EXPECT_EQ(CQuarnCommand::success,
              run(L"SetTurntableAnimation 4 Klockwise _Enter _Enter _Enter _Enter"));
    EXPECT_EQ(4, record().FrameCount());
    EXPECT_THAT(printed(), HasSubstr(L"SetTurntableAnimation: \"Klockwise\" is no option here. "
                                     L"The options are Clockwise, AntiClockwise.\n"));
}

TEST_F(Turntable, ACaptureMethodThatIsNoneEndsItAndIsTold) {
    EXPECT_EQ(CQuarnCommand::failure,
              run(L"SetTurntableAnimation 4 _Enter _jpg _ShadedViewport _Enter _Enter"));
    EXPECT_THAT(printed(), HasSubstr(L"SetTurntableAnimation: \"_ShadedViewport\" is no option "
                                     L"here. The options are RenderFull, RenderPreview, "));
}

TEST_F(Turntable, CancelledDirectionEndsItWithAMessage) {
    record() = marked();
    EXPECT_EQ(CQuarnCommand::cancel, run(L"SetTurntableAnimation 8 _Cancel"));
    EXPECT_THAT(printed(), HasSubstr(L"Failed to select direction. Nothing done\n"));
    expectRecordUntouched();
}

TEST_F(Turntable, CancelledOptionsLeaveTheRecordUntouched) {
    record() = marked();
    EXPECT_EQ(CQuarnCommand::cancel,
              run(L"SetTurntableAnimation 8 AntiClockwise _png _Shaded Perspective _Cancel"));
    EXPECT_THAT(printed(), HasSubstr(L"Invalid name. Nothing done\n"));
    expectRecordUntouched();
    EXPECT_EQ(CQuarnCommand::failure, run(L"SetTurntableAnimation 8 _Enter _png _Shaded Nowhere"));
    expectRecordUntouched();
}

TEST_F(Turntable, AnswersAreStoredWithTheAnimation) {
    ASSERT_EQ(CQuarnCommand::success,
              run(L"SetTurntableAnimation 6 _Clockwise _png _RenderedViewport front Other"));
    EXPECT_EQ(L"png", record().FileExtension().View());
    EXPECT_EQ(L"RenderedViewport", record().CaptureMethod().View());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(), record().DisplayMode());
    EXPECT_EQ(L"front", record().ViewportName().View());
    EXPECT_EQ(L"Walk", record().HtmlFilename().View());
}

TEST_F(Turntable, CommandLineNeverReturnsToClockwise) {
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"AntiClockwise"));
    const KM_3dPointArray anticlockwise = record().CameraPoints();
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"Clockwise"));
    EXPECT_EQ(anticlockwise, record().CameraPoints());
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"_Enter"));
    EXPECT_EQ(anticlockwise, record().CameraPoints());
}

TEST_F(Turntable, DirectionIsRememberedWhenALaterQuestionIsNotAnswered) {
    ASSERT_EQ(CQuarnCommand::cancel,
              run(L"SetTurntableAnimation 8 AntiClockwise _png _Shaded Perspective _Cancel"));
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"_Enter"));
    expectAnticlockwise();
}

TEST_F(Turntable, DirectionIsRememberedForTheNextDocument) {
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"AntiClockwise"));
    ASSERT_EQ(CQuarnCommand::success, run(L"_-New"));
    placeCamera(L"Perspective", eye, target);
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"_Enter"));
    expectAnticlockwise();
}

TEST_F(Turntable, EnterKeepsTheRememberedDirectionThoughClockwiseIsShown) {
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"AntiClockwise"));
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"_Enter"));
    const std::vector<quarn::Question>& questions = front_end.questions();
    EXPECT_EQ(L"Clockwise", questions.at(questions.size() - 5).default_answer->View());
    expectAnticlockwise();
}

TEST_F(Turntable, HundredThousandFramesAreDivided) {
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"100000", L"_Enter"));
    EXPECT_EQ(100000, record().CameraPoints().Count());
    EXPECT_EQ(100000, record().TargetPoints().Count());
}
