#include "kelmar/KM_Circle.h"
#include "tests/zoetrix/fixtures/PathFixture.h"

using testing::ElementsAre;
using testing::HasSubstr;

namespace {

class FlythroughCommand : public PathFixture {
protected:
    KM_3dPointArray camera() { return record().CameraPoints(); }
    KM_3dPointArray target() { return record().TargetPoints(); }

    /// Runs the line, which must end like this with this message and leave the record alone.
    void expectFailure(CQuarnCommand::result ended, const wchar_t* message, const wchar_t* line) {
        front_end.clearPrinted();
        EXPECT_EQ(ended, run(line)) << KM_wString(line).ToUtf8();
        EXPECT_THAT(printed(), HasSubstr(message)) << KM_wString(line).ToUtf8();
        expectRecordUntouched();
    }
};

constexpr const wchar_t* no_pick = L"Failed to select path. Nothing done\n";
constexpr const wchar_t* no_curve = L"Failed to select camera path or point. Nothing done\n";
constexpr const wchar_t* no_points = L"Failed to divide camera path. Nothing done\n";

} // namespace

TEST_F(FlythroughCommand, CameraRunsAlongALineAndLooksAlongIt) {
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"rail", L"5"));
    const KM_3dmAnimationProperties& props = record();
    EXPECT_EQ(KM_3dmAnimationProperties::flythrough, props.CaptureType());
    EXPECT_EQ(5, props.FrameCount());
    EXPECT_EQ(0, props.CurrentFrame());
    EXPECT_EQ(objectId(L"rail"), props.CameraPathId());
    EXPECT_EQ(objectId(L"rail"), props.TargetPathId());
    // A fifth of the line's 10 units a frame; the camera ends at four fifths of it.
    ASSERT_EQ(5, camera().Count());
    ASSERT_EQ(5, target().Count());
    for (int k = 0; k < 5; ++k) {
        EXPECT_TRUE(near(camera()[k], KM_3dPoint(2.0 * k, 0.0, 1.0), 1e-14)) << k;
        EXPECT_TRUE(near(target()[k], KM_3dPoint(2.0 * (k + 1), 0.0, 1.0), 1e-14)) << k;
    }
    EXPECT_TRUE(near(target()[4], KM_3dPoint(10.0, 0.0, 1.0), 0.0));
}

TEST_F(FlythroughCommand, StepsAreEqualInTheParameterAndTheTargetIsOneAhead) {
    addCurve(L"uneven", unevenCurve());
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"uneven", L"4"));
    KM_3dPointArray all_but_last = uneven_points;
    all_but_last.Remove(4);
    KM_3dPointArray all_but_first = uneven_points;
    all_but_first.Remove(0);
    EXPECT_TRUE(near(camera(), all_but_last, 1e-14));
    EXPECT_TRUE(near(target(), all_but_first, 1e-14));
}

TEST_F(FlythroughCommand, TargetOfAFrameIsTheCameraOfTheNextToTheLastBit) {
    addCurve(L"uneven", unevenCurve());
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"uneven", L"97"));
    ASSERT_EQ(97, camera().Count());
    for (int k = 0; k + 1 < 97; ++k)
        EXPECT_EQ(camera()[k + 1], target()[k]) << k;
}

TEST_F(FlythroughCommand, ReversedCurveIsFlownTheOtherWay) {
    KM_NurbsCurve curve = unevenCurve();
    ASSERT_TRUE(curve.Reverse());
    addCurve(L"backward", curve);
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"backward", L"4"));
    EXPECT_TRUE(near(camera()[0], uneven_points[4], 1e-14));
    EXPECT_TRUE(near(target()[0], uneven_points[3], 1e-14));
    EXPECT_TRUE(near(target()[3], uneven_points[0], 1e-14));
}

TEST_F(FlythroughCommand, ClosedCurveStartsAtItsSeamAndLooksBackAtItInTheEnd) {
    KM_NurbsCurve circle;
    ASSERT_EQ(2, KM_Circle(KM_xy_plane, 3.0).GetNurbForm(circle));
    addCurve(L"ring", circle);
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"ring", L"4"));
    EXPECT_TRUE(near(
        camera(),
        KM_3dPointArray({{3.0, 0.0, 0.0}, {0.0, 3.0, 0.0}, {-3.0, 0.0, 0.0}, {0.0, -3.0, 0.0}}),
        1e-14));
    EXPECT_TRUE(near(
        target(),
        KM_3dPointArray({{0.0, 3.0, 0.0}, {-3.0, 0.0, 0.0}, {0.0, -3.0, 0.0}, {3.0, 0.0, 0.0}}),
        1e-14));
}

TEST_F(FlythroughCommand, OneFrameLooksFromTheStartToTheEnd) {
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"rail", L"1"));
    EXPECT_EQ(KM_3dPointArray({{0.0, 0.0, 1.0}}), camera());
    EXPECT_EQ(KM_3dPointArray({{10.0, 0.0, 1.0}}), target());
}

TEST_F(FlythroughCommand, PlacesThatCannotBeEvaluatedAreLeftOutOfEachListByItself) {
    // Of the places 0 to 4 the first is missing, which the target never is at.
    addCurve(L"torn", curveWithHoleAt(0));
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"torn", L"4"));
    EXPECT_EQ(KM_3dPointArray({{10.0, 0.0, 0.0}, {20.0, 0.0, 0.0}, {30.0, 0.0, 0.0}}), camera());
    EXPECT_EQ(
        KM_3dPointArray({{10.0, 0.0, 0.0}, {20.0, 0.0, 0.0}, {30.0, 0.0, 0.0}, {40.0, 0.0, 0.0}}),
        target());
    EXPECT_EQ(4, record().FrameCount());
    EXPECT_EQ(CQuarnCommand::failure, run(L"PlayAnimation"));
}

TEST_F(FlythroughCommand, CurveWithoutLengthStaysInItsPlace) {
    const KM_3dPoint place(1.0, 1.0, 1.0);
    addCurve(L"nowhere", KM_LineCurve(place, place));
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"nowhere", L"2"));
    EXPECT_EQ(KM_3dPointArray({place, place}), camera());
    EXPECT_EQ(KM_3dPointArray({place, place}), target());
}

TEST_F(FlythroughCommand, CurveThatCannotBeDividedFails) {
    addCurve(L"void", curveWithoutPoints());
    expectFailure(CQuarnCommand::failure, no_points,
                  L"SetFlythroughAnimation void 5 _Enter _Enter _Enter _Enter");
}

TEST_F(FlythroughCommand, QuestionsHaveTheirTextsAndDefaults) {
    record().SetFrameCount(42);
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"rail", L"_Enter"));
    ASSERT_EQ(6U, front_end.questions().size());
    const quarn::Question& first = front_end.questions()[0];
    EXPECT_EQ(L"Select path curve for camera and target", first.prompt.View());
    EXPECT_TRUE(first.accepts_nothing);
    EXPECT_THAT(first.object_names, ElementsAre(L"rail", L"gaze"));
    EXPECT_EQ(L"Number of frames", front_end.questions()[1].prompt.View());
    EXPECT_EQ(L"42", front_end.questions()[1].default_answer->View());
    EXPECT_EQ(42, record().FrameCount());
}

TEST_F(FlythroughCommand, NamesWithBlanksAreQuoted) {
    addCurve(L"north walk", KM_LineCurve({0.0, 9.0, 0.0}, {4.0, 9.0, 0.0}));
    ASSERT_EQ(CQuarnCommand::success,
              run(L"SetFlythroughAnimation \"North Walk\" 2 _Enter _Enter _Enter _Enter"));
    EXPECT_EQ(KM_3dPointArray({{0.0, 9.0, 0.0}, {2.0, 9.0, 0.0}}), camera());
}

TEST_F(FlythroughCommand, EnterTakesTheCurveOfTheLastSetUpAsItIsNow) {
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"rail", L"2"));
    editCurve(L"rail", KM_LineCurve({0.0, 0.0, 8.0}, {2.0, 0.0, 8.0}));
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"_Enter", L"_Enter"));
    EXPECT_EQ(objectId(L"rail"), record().CameraPathId());
    EXPECT_EQ(KM_3dPointArray({{0.0, 0.0, 8.0}, {1.0, 0.0, 8.0}}), camera());
}

TEST_F(FlythroughCommand, ItsCurveIsTheLastCameraPathOfTheOtherCommandAndTheReverse) {
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"gaze", L"2"));
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"_Enter", L"spot", L"2"));
    EXPECT_EQ(objectId(L"gaze"), record().CameraPathId());
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"spot", L"2"));
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"_Enter", L"2"));
    EXPECT_EQ(objectId(L"rail"), record().CameraPathId());
}

TEST_F(FlythroughCommand, EnterForWhatIsNoCurveFails) {
    expectFailure(CQuarnCommand::failure, no_curve, L"SetFlythroughAnimation _Enter");
    record().SetCameraPathId(objectId(L"spot"));
    expectFailure(CQuarnCommand::failure, no_curve, L"SetFlythroughAnimation _Enter");
    record().SetCameraPathId(objectId(L"slab"));
    expectFailure(CQuarnCommand::failure, no_curve, L"SetFlythroughAnimation _Enter");
    record().SetCameraPathId(objectId(L"rail"));
    remove(L"rail");
    expectFailure(CQuarnCommand::failure, no_curve, L"SetFlythroughAnimation _Enter");
}

TEST_F(FlythroughCommand, PicksThatFailEndItWithTheirResult) {
    for (const wchar_t* pick : {L"_Cancel", L"nobody", L"slab", L"spot"}) {
        const KM_wString line = KM_wString(L"SetFlythroughAnimation ") + pick + L" 5";
        expectFailure(CQuarnCommand::cancel, no_pick, line);
    }
    expectFailure(CQuarnCommand::cancel, no_pick, L"SetFlythroughAnimation");
}

TEST_F(FlythroughCommand, SelectedCurvesAreNotTakenWithoutAsking) {
    ASSERT_EQ(CQuarnCommand::success, run(L"_-Select rail _Enter"));
    expectFailure(CQuarnCommand::failure, no_curve, L"SetFlythroughAnimation _Enter");
}

TEST_F(FlythroughCommand, BadFrameCountsEndItWithAMessage) {
    for (const wchar_t* frames : {L"0", L"-3", L"many", L"1.5", L"99999999999", L"_Cancel"}) {
        const KM_wString line = KM_wString(L"SetFlythroughAnimation rail ") + frames + L" _Enter";
        expectFailure(CQuarnCommand::cancel, L"Invalid number of frames. Nothing done\n", line);
    }
}

TEST_F(FlythroughCommand, CancelledOptionsLeaveTheRecordUntouched) {
    expectFailure(CQuarnCommand::cancel, L"Invalid name. Nothing done\n",
                  L"SetFlythroughAnimation rail 8 _png _Shaded Perspective _Cancel");
    expectFailure(CQuarnCommand::failure, L"Invalid viewport name. Nothing done\n",
                  L"SetFlythroughAnimation rail 8 _png _Shaded Nowhere");
}

TEST_F(FlythroughCommand, AnswersAreStoredAndTheNameIsNotChecked) {
    record().SetHtmlFilename(L"a<b>");
    ASSERT_EQ(CQuarnCommand::success,
              run(L"SetFlythroughAnimation rail 6 _png _RenderedViewport front Other"));
    EXPECT_EQ(L"png", record().FileExtension().View());
    EXPECT_EQ(L"RenderedViewport", record().CaptureMethod().View());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(), record().DisplayMode());
    EXPECT_EQ(L"front", record().ViewportName().View());
    EXPECT_EQ(L"a<b>", record().HtmlFilename().View());
    EXPECT_EQ(6, record().FrameCount());
}

TEST_F(FlythroughCommand, HundredThousandFramesAreDivided) {
    ASSERT_EQ(CQuarnCommand::success, setUpFlythrough(L"rail", L"100000"));
    EXPECT_EQ(100000, camera().Count());
    EXPECT_EQ(100000, target().Count());
}
