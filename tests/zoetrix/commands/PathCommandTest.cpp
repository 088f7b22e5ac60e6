#include "kelmar/KM_Circle.h"
#include "tests/zoetrix/fixtures/PathFixture.h"

#include <array>

using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;

namespace {

constexpr const wchar_t* no_camera = L"Failed to select camera path or point. Nothing done\n";
constexpr const wchar_t* no_target = L"Failed to select target path or point. Nothing done\n";

class PathCommand : public PathFixture {
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

    const KM_3dPoint spot{1.0, 2.0, 3.0};
    const KM_3dPoint nest{-4.0, 0.0, 2.0};
};

KM_NurbsCurve circleOfRadius3() {
    KM_NurbsCurve circle;
    EXPECT_EQ(2, KM_Circle(KM_xy_plane, 3.0).GetNurbForm(circle));
    return circle;
}

} // namespace

TEST_F(PathCommand, CameraAndTargetFollowTheirCurvesFromEndToEnd) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"gaze", L"5"));
    const KM_3dmAnimationProperties& props = record();
    EXPECT_EQ(KM_3dmAnimationProperties::path, props.CaptureType());
    EXPECT_EQ(5, props.FrameCount());
    EXPECT_EQ(0, props.CurrentFrame());
    EXPECT_EQ(objectId(L"rail"), props.CameraPathId());
    EXPECT_EQ(objectId(L"gaze"), props.TargetPathId());
    EXPECT_TRUE(near(
        camera(),
        KM_3dPointArray(
            {{0.0, 0.0, 1.0}, {2.5, 0.0, 1.0}, {5.0, 0.0, 1.0}, {7.5, 0.0, 1.0}, {10.0, 0.0, 1.0}}),
        0.0));
    EXPECT_TRUE(near(
        target(),
        KM_3dPointArray(
            {{0.0, 0.0, 5.0}, {0.0, 1.0, 5.0}, {0.0, 2.0, 5.0}, {0.0, 3.0, 5.0}, {0.0, 4.0, 5.0}}),
        0.0));
}

TEST_F(PathCommand, StepsAreEqualInTheParameterNotInLength) {
    addCurve(L"uneven", unevenCurve());
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"uneven", L"uneven", L"5"));
    EXPECT_TRUE(near(camera(), uneven_points, 1e-14));
    EXPECT_TRUE(near(target(), uneven_points, 1e-14));
}

TEST_F(PathCommand, ReversedCurveIsFollowedTheOtherWay) {
    KM_NurbsCurve curve = unevenCurve();
    ASSERT_TRUE(curve.Reverse());
    addCurve(L"backward", curve);
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"backward", L"spot", L"5"));
    KM_3dPointArray backward = uneven_points;
    backward.Reverse();
    EXPECT_TRUE(near(camera(), backward, 1e-14));
}

TEST_F(PathCommand, ClosedRationalCurveTakesItsSeamOnceAsTheLastFrame) {
    addCurve(L"ring", circleOfRadius3());
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"ring", L"ring", L"4"));
    const KM_3dPointArray quarters = {
        {0.0, 3.0, 0.0}, {-3.0, 0.0, 0.0}, {0.0, -3.0, 0.0}, {3.0, 0.0, 0.0}};
    EXPECT_TRUE(near(camera(), quarters, 1e-14));
    EXPECT_TRUE(near(target(), quarters, 1e-14));
}

TEST_F(PathCommand, ClosedPolylineGoesRoundItsCornersOnce) {
    const std::array<KM_3dPoint, 5> square = {
        {{0.0, 0.0, 0.0}, {2.0, 0.0, 0.0}, {2.0, 2.0, 0.0}, {0.0, 2.0, 0.0}, {0.0, 0.0, 0.0}}};
    addCurve(L"yard", KM_PolylineCurve(square));
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"yard", L"spot", L"4"));
    EXPECT_TRUE(
        near(camera(),
             KM_3dPointArray({{2.0, 0.0, 0.0}, {2.0, 2.0, 0.0}, {0.0, 2.0, 0.0}, {0.0, 0.0, 0.0}}),
             0.0));
}

TEST_F(PathCommand, KinkedCurveIsMetAtItsKink) {
    const std::array<KM_3dPoint, 3> corners = {
        {{0.0, 0.0, 0.0}, {10.0, 0.0, 0.0}, {10.0, 2.0, 0.0}}};
    addCurve(L"corner", KM_PolylineCurve(corners));
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"corner", L"spot", L"5"));
    EXPECT_TRUE(near(camera(),
                     KM_3dPointArray({{0.0, 0.0, 0.0},
                                      {5.0, 0.0, 0.0},
                                      {10.0, 0.0, 0.0},
                                      {10.0, 1.0, 0.0},
                                      {10.0, 2.0, 0.0}}),
                     0.0));
}

TEST_F(PathCommand, TwoPointsOfferOneFrameAndMakeAStillCamera) {
    record().SetFrameCount(42);
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"nest", L"spot", L"_Enter"));
    EXPECT_EQ(L"1", front_end.questions().at(2).default_answer->View());
    EXPECT_EQ(1, record().FrameCount());
    EXPECT_EQ(KM_3dPointArray({nest}), camera());
    EXPECT_EQ(KM_3dPointArray({spot}), target());
    EXPECT_EQ(objectId(L"nest"), record().CameraPathId());
    EXPECT_EQ(objectId(L"spot"), record().TargetPathId());
}

TEST_F(PathCommand, TwoPointsAreRepeatedForAsManyFramesAsAreWanted) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"nest", L"spot", L"3"));
    EXPECT_EQ(KM_3dPointArray({nest, nest, nest}), camera());
    EXPECT_EQ(KM_3dPointArray({spot, spot, spot}), target());
}

TEST_F(PathCommand, EveryFrameLooksAtATargetPoint) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"spot", L"3"));
    EXPECT_TRUE(
        near(camera(), KM_3dPointArray({{0.0, 0.0, 1.0}, {5.0, 0.0, 1.0}, {10.0, 0.0, 1.0}}), 0.0));
    EXPECT_EQ(KM_3dPointArray({spot, spot, spot}), target());
}

TEST_F(PathCommand, CameraPointPansAlongATargetCurve) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"nest", L"gaze", L"3"));
    EXPECT_EQ(KM_3dPointArray({nest, nest, nest}), camera());
    EXPECT_TRUE(
        near(target(), KM_3dPointArray({{0.0, 0.0, 5.0}, {0.0, 2.0, 5.0}, {0.0, 4.0, 5.0}}), 0.0));
}

TEST_F(PathCommand, OneFrameIsTheStartOfEachCurveEvenOfAClosedOne) {
    addCurve(L"ring", circleOfRadius3());
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"ring", L"gaze", L"1"));
    EXPECT_EQ(KM_3dPointArray({{3.0, 0.0, 0.0}}), camera());
    EXPECT_EQ(KM_3dPointArray({{0.0, 0.0, 5.0}}), target());
}

TEST_F(PathCommand, CurveWithoutLengthIsAPlaceToStay) {
    addCurve(L"nowhere", KM_LineCurve(nest, nest));
    addCurve(L"knot", KM_PolylineCurve(std::array<KM_3dPoint, 3>{spot, spot, spot}));
    record().SetFrameCount(3);
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"nowhere", L"knot", L"_Enter"));
    EXPECT_EQ(L"3", front_end.questions().at(2).default_answer->View());
    EXPECT_EQ(KM_3dPointArray({nest, nest, nest}), camera());
    EXPECT_EQ(KM_3dPointArray({spot, spot, spot}), target());
}

TEST_F(PathCommand, PlacesThatCannotBeEvaluatedAreLeftOut) {
    addCurve(L"torn", curveWithHoleAt(2));
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"torn", L"gaze", L"5"));
    const KM_3dPointArray all_but_one = {
        {0.0, 0.0, 0.0}, {10.0, 0.0, 0.0}, {30.0, 0.0, 0.0}, {40.0, 0.0, 0.0}};
    EXPECT_TRUE(near(camera(), all_but_one, 0.0));
    EXPECT_EQ(5, target().Count());
    EXPECT_EQ(5, record().FrameCount());
    EXPECT_EQ(CQuarnCommand::failure, run(L"PlayAnimation"));
    EXPECT_THAT(printed(), HasSubstr(L"No animation is currently set. There is nothing to view\n"));
}

TEST_F(PathCommand, CurvesThatCannotBeDividedAreToldByTheirPart) {
    addCurve(L"void", curveWithoutPoints());
    expectFailure(CQuarnCommand::failure, L"Failed to divide camera path. Nothing done\n",
                  L"SetPathAnimation void gaze 5 _Enter _Enter _Enter _Enter");
    EXPECT_THAT(printed(), Not(HasSubstr(L"target")));
    expectFailure(CQuarnCommand::failure, L"Failed to divide target path. Nothing done\n",
                  L"SetPathAnimation rail void 5 _Enter _Enter _Enter _Enter");
    EXPECT_THAT(printed(), Not(HasSubstr(L"camera")));
}

TEST_F(PathCommand, QuestionsHaveTheirTextsAndDefaults) {
    record().SetFrameCount(42);
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"spot", L"_Enter"));
    ASSERT_EQ(7U, front_end.questions().size());
    const quarn::Question& first = front_end.questions()[0];
    EXPECT_EQ(L"Select camera path curve or point. Press Enter to select last camera path",
              first.prompt.View());
    EXPECT_TRUE(first.accepts_nothing);
    EXPECT_THAT(first.object_names, ElementsAre(L"rail", L"gaze", L"spot", L"nest"));
    const quarn::Question& second = front_end.questions()[1];
    EXPECT_EQ(L"Select target path curve or point. Press Enter to select last target path",
              second.prompt.View());
    EXPECT_TRUE(second.accepts_nothing);
    EXPECT_THAT(second.object_names, ElementsAre(L"rail", L"gaze", L"spot", L"nest"));
    EXPECT_EQ(L"Number of frames", front_end.questions()[2].prompt.View());
    EXPECT_EQ(L"42", front_end.questions()[2].default_answer->View());
    EXPECT_EQ(42, record().FrameCount());
}

TEST_F(PathCommand, NamesWithBlanksAreQuoted) {
    addCurve(L"north walk", KM_LineCurve({0.0, 9.0, 0.0}, {4.0, 9.0, 0.0}));
    addPoint(L"front door", {7.0, 7.0, 7.0});
    ASSERT_EQ(CQuarnCommand::success,
              run(L"SetPathAnimation \"north walk\" \"Front Door\" 2 _Enter _Enter _Enter _Enter"));
    EXPECT_EQ(KM_3dPointArray({{0.0, 9.0, 0.0}, {4.0, 9.0, 0.0}}), camera());
    EXPECT_EQ(KM_3dPointArray({{7.0, 7.0, 7.0}, {7.0, 7.0, 7.0}}), target());
}

TEST_F(PathCommand, ObjectsAreGivenByTheirIdsToo) {
    const KM_wString line = L"SetPathAnimation " + KM_UuidToString(objectId(L"rail")) + L" " +
                            KM_UuidToString(objectId(L"spot")) + L" 2 _Enter _Enter _Enter _Enter";
    ASSERT_EQ(CQuarnCommand::success, run(line));
    EXPECT_EQ(objectId(L"rail"), record().CameraPathId());
    EXPECT_EQ(objectId(L"spot"), record().TargetPathId());
}

TEST_F(PathCommand, EnterTakesTheObjectsOfTheLastSetUp) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"spot", L"3"));
    const KM_UUID rail = objectId(L"rail");
    editCurve(L"rail", KM_LineCurve({0.0, 0.0, 8.0}, {2.0, 0.0, 8.0}));
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"_Enter", L"_Enter", L"_Enter"));
    EXPECT_EQ(rail, record().CameraPathId());
    EXPECT_EQ(objectId(L"spot"), record().TargetPathId());
    EXPECT_EQ(KM_3dPointArray({{0.0, 0.0, 8.0}, {1.0, 0.0, 8.0}, {2.0, 0.0, 8.0}}), camera());
    EXPECT_EQ(KM_3dPointArray({spot, spot, spot}), target());
}

TEST_F(PathCommand, EnterAtOneQuestionKeepsTheOtherAnswer) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"gaze", L"2"));
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"nest", L"_Enter", L"2"));
    EXPECT_EQ(objectId(L"nest"), record().CameraPathId());
    EXPECT_EQ(objectId(L"gaze"), record().TargetPathId());
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"_Enter", L"rail", L"2"));
    EXPECT_EQ(objectId(L"nest"), record().CameraPathId());
    EXPECT_EQ(objectId(L"rail"), record().TargetPathId());
}

TEST_F(PathCommand, TheObjectsOfTheLastSetUpAreInTheDocumentsFile) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"spot", L"3"));
    const KM_wString file = L" \"" + wide(folder / "a.quarn") + L"\"";
    ASSERT_EQ(CQuarnCommand::success, run(L"_-SaveAs" + file));
    ASSERT_EQ(CQuarnCommand::success, run(L"_-New"));
    ASSERT_EQ(CQuarnCommand::success, run(L"_-Open" + file));
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"_Enter", L"_Enter", L"5"));
    EXPECT_EQ(5, camera().Count());
    EXPECT_TRUE(near(camera()[4], KM_3dPoint(10.0, 0.0, 1.0), 0.0));
}

TEST_F(PathCommand, EnterWithoutAnEarlierSetUpFails) {
    expectFailure(CQuarnCommand::failure, no_camera, L"SetPathAnimation _Enter");
    expectFailure(CQuarnCommand::failure, no_target, L"SetPathAnimation rail _Enter");
}

TEST_F(PathCommand, EnterForAnObjectThatIsGoneFails) {
    record().SetCameraPathId(objectId(L"rail"));
    record().SetTargetPathId(objectId(L"spot"));
    remove(L"rail");
    expectFailure(CQuarnCommand::failure, no_camera, L"SetPathAnimation _Enter spot");
    remove(L"spot");
    expectFailure(CQuarnCommand::failure, no_target, L"SetPathAnimation nest _Enter");
}

TEST_F(PathCommand, EnterForAnObjectThatIsNeitherCurveNorPointFails) {
    record().SetCameraPathId(objectId(L"slab"));
    record().SetTargetPathId(objectId(L"slab"));
    expectFailure(CQuarnCommand::failure, no_camera, L"SetPathAnimation _Enter spot");
    expectFailure(CQuarnCommand::failure, no_target, L"SetPathAnimation rail _Enter");
}

TEST_F(PathCommand, PicksThatFailEndItWithTheirResult) {
    for (const wchar_t* pick : {L"_Cancel", L"nobody", L"slab"}) {
        const KM_wString line = KM_wString(L"SetPathAnimation ") + pick + L" spot 5";
        expectFailure(CQuarnCommand::cancel, no_camera, line);
        EXPECT_THAT(printed(), Not(HasSubstr(no_target)));
        const KM_wString second = KM_wString(L"SetPathAnimation rail ") + pick + L" 5";
        expectFailure(CQuarnCommand::cancel, no_target, second);
        EXPECT_THAT(printed(), Not(HasSubstr(no_camera)));
    }
    expectFailure(CQuarnCommand::cancel, no_camera, L"SetPathAnimation");
}

TEST_F(PathCommand, SelectedObjectsAreNotTakenWithoutAsking) {
    ASSERT_EQ(CQuarnCommand::success, run(L"_-Select rail _Enter"));
    expectFailure(CQuarnCommand::failure, no_camera, L"SetPathAnimation _Enter");
}

TEST_F(PathCommand, BadFrameCountsEndItWithAMessage) {
    for (const wchar_t* frames : {L"0", L"-3", L"many", L"1.5", L"99999999999", L"_Cancel"}) {
        const KM_wString line = KM_wString(L"SetPathAnimation rail spot ") + frames + L" _Enter";
        expectFailure(CQuarnCommand::cancel, L"Invalid number of frames. Nothing done\n", line);
    }
}

TEST_F(PathCommand, CancelledOptionsLeaveTheRecordUntouched) {
    expectFailure(CQuarnCommand::cancel, L"Invalid name. Nothing done\n",
                  L"SetPathAnimation rail spot 8 _png _Shaded Perspective _Cancel");
    expectFailure(CQuarnCommand::failure, L"Invalid viewport name. Nothing done\n",
                  L"SetPathAnimation rail spot 8 _png _Shaded Nowhere");
}

TEST_F(PathCommand, AnswersAreStoredWithTheAnimation) {
    ASSERT_EQ(CQuarnCommand::success,
              run(L"SetPathAnimation rail gaze 6 _png _RenderedViewport front Other"));
    EXPECT_EQ(L"png", record().FileExtension().View());
    EXPECT_EQ(L"RenderedViewport", record().CaptureMethod().View());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(), record().DisplayMode());
    EXPECT_EQ(L"front", record().ViewportName().View());
    EXPECT_EQ(L"Walk", record().HtmlFilename().View());
    EXPECT_THAT(printed(), Not(HasSubstr(L"invalid letters")));
}

TEST_F(PathCommand, PreviewRenderingAtTheCommandLineIsPreviewRendering) {
    ASSERT_EQ(CQuarnCommand::success,
              run(L"SetPathAnimation rail gaze 6 _png _RenderPreview front Other"));
    EXPECT_FALSE(record().RenderFull());
    EXPECT_TRUE(record().RenderPreview());
}

TEST_F(PathCommand, InvalidNameIsRepairedAndTold) {
    record().SetHtmlFilename(L"a<b>%s");
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"spot", L"2"));
    EXPECT_EQ(L"a_b_%s", record().HtmlFilename().View());
    EXPECT_THAT(printed(),
                HasSubstr(L"The animation name (a<b>%s) has invalid letters. Changed to (a_b_%s)"));
    EXPECT_TRUE(front_end.messages().empty());
}

TEST_F(PathCommand, InvalidNameIsLeftAloneWhenAnOptionIsCancelled) {
    for (const wchar_t* name : {L"a<b>", L""}) {
        record().SetHtmlFilename(name);
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::cancel,
                  run(L"SetPathAnimation rail spot 2 _Enter _Enter _Enter _Cancel"));
        EXPECT_EQ(L"Invalid name. Nothing done\n", printed());
        EXPECT_EQ(name, record().HtmlFilename().View());
    }
}

TEST_F(PathCommand, NameThatCannotBeRepairedEndsIt) {
    for (const std::wstring& name : {std::wstring(), std::wstring(256, L'a')}) {
        record().SetHtmlFilename(name.c_str());
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::cancel,
                  run(L"SetPathAnimation rail spot 2 _Enter _Enter _Enter Other"));
        EXPECT_THAT(printed(), HasSubstr(L"Failed. Invalid animation name\n"));
        EXPECT_EQ(KM_3dmAnimationProperties::none, record().CaptureType());
        EXPECT_TRUE(record().CameraPoints().IsEmpty());
    }
    EXPECT_TRUE(front_end.messages().empty());
}

TEST_F(PathCommand, LongNameWithAnInvalidCharacterIsRepairedAndKept) {
    // One replaced character is enough for it to go on; that the name is too long stays.
    record().SetHtmlFilename((L"?" + std::wstring(299, L'a')).c_str());
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"spot", L"2"));
    EXPECT_EQ(L"_" + std::wstring(299, L'a'), record().HtmlFilename().View());
}

TEST_F(PathCommand, HundredThousandFramesAreDivided) {
    ASSERT_EQ(CQuarnCommand::success, setUpPath(L"rail", L"spot", L"100000"));
    EXPECT_EQ(100000, camera().Count());
    EXPECT_EQ(100000, target().Count());
}
