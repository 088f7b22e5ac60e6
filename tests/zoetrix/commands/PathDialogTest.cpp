#include "sdk/vexui/VexUi.h"
#include "tests/zoetrix/fixtures/PathFixture.h"

#include <functional>

using testing::HasSubstr;

namespace {

/// What is the same in both commands that follow curves: which of them runs is the parameter.
enum class Following { path, flythrough };

class PathDialog : public PathFixture, public testing::WithParamInterface<Following> {
protected:
    CQuarnCommand::result confirm() {
        return GetParam() == Following::path ? pathInDialog(L"rail", L"spot", entered)
                                             : flythroughInDialog(L"rail", entered);
    }

    Entered entered;
};

class PathDialogOnly : public PathFixture {};
class FlythroughDialogOnly : public PathFixture {};

class MissingDialog : public PathFixture, public testing::WithParamInterface<Following> {
protected:
    explicit MissingDialog(const std::string& plug_ins) : PathFixture(plug_ins) {}

    CQuarnCommand::result runInteractively() {
        return GetParam() == Following::path ? pathInDialog(L"rail", L"spot", {})
                                             : flythroughInDialog(L"rail", {});
    }
};

class PathWithoutDialogPlugIn : public MissingDialog {
protected:
    PathWithoutDialogPlugIn() : MissingDialog("") {}
};
class PathWithoutItsDialog : public MissingDialog {
protected:
    PathWithoutItsDialog() : MissingDialog("no-dialogs") {}
};

const auto both = testing::Values(Following::path, Following::flythrough);

std::string nameOf(const testing::TestParamInfo<Following>& following) {
    return following.param == Following::path ? "Path" : "Flythrough";
}

INSTANTIATE_TEST_SUITE_P(Following, PathDialog, both, nameOf);
INSTANTIATE_TEST_SUITE_P(Following, PathWithoutDialogPlugIn, both, nameOf);
INSTANTIATE_TEST_SUITE_P(Following, PathWithoutItsDialog, both, nameOf);

} // namespace

TEST_P(PathDialog, ShowsTheChoicesAndTheRecordWithoutDirections) {
    record().SetFrameCount(33);
    record().SetFileExtension(L"tga");
    record().SetCaptureMethod(L"XRay");
    record().SetViewportName(L"Right");
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ("path", shownDialog());
    EXPECT_EQ("frames=33;name=Walk;files=jpg,bmp,png,tga@3;"
              "captures=RenderFull,RenderPreview,Wireframe,Shaded,RenderedViewport,Translucent,"
              "XRay,Drawing,Clay@6;viewports=Top,Front,Right,Perspective@2;directions=@0",
              shownInDialog());
}

TEST_P(PathDialog, StoresWhatWasChosen) {
    entered = {.file_type = 2, .method = 4, .viewport = 1, .frames = 8, .name = "Stroll"};
    ASSERT_EQ(CQuarnCommand::success, confirm());
    const KM_3dmAnimationProperties& props = record();
    EXPECT_EQ(8, props.FrameCount());
    EXPECT_EQ(0, props.CurrentFrame());
    EXPECT_EQ(8, props.CameraPoints().Count());
    EXPECT_EQ(8, props.TargetPoints().Count());
    EXPECT_EQ(L"png", props.FileExtension().View());
    EXPECT_EQ(L"RenderedViewport", props.CaptureMethod().View());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(), props.DisplayMode());
    EXPECT_FALSE(props.RenderFull());
    EXPECT_FALSE(props.RenderPreview());
    EXPECT_EQ(L"Front", props.ViewportName().View());
    EXPECT_EQ(L"Stroll", props.HtmlFilename().View());
    EXPECT_TRUE(front_end.messages().empty());
}

TEST_P(PathDialog, BothRenderMethodsRecordWithTheFullRenderer) {
    const KM_UUID mode = CQuarnDisplayAttrsMgr::RenderedModeId();
    for (const int method : {0, 1}) {
        record().SetDisplayMode(mode);
        record().SetRenderFull(false);
        record().SetRenderPreview(true);
        entered.method = method;
        ASSERT_EQ(CQuarnCommand::success, confirm());
        EXPECT_EQ(method == 0 ? L"RenderFull" : L"RenderPreview", record().CaptureMethod().View());
        EXPECT_TRUE(record().RenderFull()) << method;
        EXPECT_FALSE(record().RenderPreview()) << method;
        EXPECT_EQ(mode, record().DisplayMode());
    }
    entered.method = 2;
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(L"Wireframe", record().CaptureMethod().View());
    EXPECT_FALSE(record().RenderFull());
    EXPECT_FALSE(record().RenderPreview());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::WireframeModeId(), record().DisplayMode());
}

TEST_P(PathDialog, SelectionsOutsideTheirListsChangeNothing) {
    const KM_UUID mode = CQuarnDisplayAttrsMgr::WireframeModeId();
    for (const int selection : {-1, -2000000000, 9, 1000, 2147483647}) {
        record() = KM_3dmAnimationProperties();
        record().SetFileExtension(L"bmp");
        record().SetCaptureMethod(L"Shaded");
        record().SetViewportName(L"Top");
        record().SetDisplayMode(mode);
        entered.file_type = entered.method = entered.viewport = selection;
        ASSERT_EQ(CQuarnCommand::success, confirm());
        EXPECT_EQ(L"bmp", record().FileExtension().View());
        EXPECT_EQ(L"Shaded", record().CaptureMethod().View());
        EXPECT_EQ(L"Top", record().ViewportName().View());
        EXPECT_EQ(mode, record().DisplayMode());
    }
}

TEST_P(PathDialog, EachSelectionIsMeasuredAgainstItsOwnList) {
    ASSERT_EQ(CQuarnCommand::success, run(L"AddView Side Front"));
    record().SetFileExtension(L"bmp");
    // Behind the last file type and the last capture method, but not behind the last of five views.
    entered.file_type = 4;
    entered.method = 9;
    entered.viewport = 4;
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(L"bmp", record().FileExtension().View());
    EXPECT_EQ(L"Shaded", record().CaptureMethod().View());
    EXPECT_EQ(L"Side", record().ViewportName().View());
    entered.file_type = 3;
    entered.method = 8;
    entered.viewport = 5;
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(L"tga", record().FileExtension().View());
    EXPECT_EQ(L"Clay", record().CaptureMethod().View());
    EXPECT_EQ(L"Side", record().ViewportName().View());
}

TEST_P(PathDialog, RenderMethodsThatAreKeptAreKnownInAnyCase) {
    entered.method = -1;
    for (const wchar_t* method : {L"renderFULL", L"renderPREVIEW"}) {
        record().SetCaptureMethod(method);
        record().SetRenderFull(false);
        record().SetRenderPreview(true);
        ASSERT_EQ(CQuarnCommand::success, confirm());
        EXPECT_TRUE(record().RenderFull());
        EXPECT_FALSE(record().RenderPreview());
        EXPECT_EQ(method, record().CaptureMethod().View());
    }
}

TEST_P(PathDialog, FrameCountsBelowOneCannotBeDivided) {
    for (const int frames : {0, -5}) {
        entered.frames = frames;
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::failure, confirm());
        EXPECT_THAT(printed(), HasSubstr(L"Failed to divide camera path. Nothing done\n"));
        expectRecordUntouched();
    }
}

TEST_P(PathDialog, ClosedUnconfirmedLeavesEverythingAsItWas) {
    entered = {.file_type = 2, .method = 0, .viewport = 1, .name = "a<b", .confirmed = false};
    EXPECT_EQ(CQuarnCommand::cancel, confirm());
    EXPECT_EQ("path", shownDialog());
    expectRecordUntouched();
    EXPECT_TRUE(front_end.messages().empty()) << "a name that is given up is not repaired";
}

TEST_P(PathDialog, InvalidNameIsRepairedAndToldInABox) {
    entered.name = "a<b>%s";
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(L"a_b_%s", record().HtmlFilename().View());
    ASSERT_EQ(1U, front_end.messages().size());
    EXPECT_EQ(L"The following characters cannot be used in the animation name: \\ / : * ? \" < > "
              L"| . The name was changed from (a<b>%s) to (a_b_%s). ",
              front_end.messages()[0].text);
    EXPECT_EQ(L"Animation", front_end.messages()[0].title);
    EXPECT_EQ(0U, front_end.messages()[0].flags);
    EXPECT_THAT(printed(), testing::Not(HasSubstr(L"invalid letters")));
}

TEST_P(PathDialog, NameThatCannotBeRepairedEndsIt) {
    for (const std::string& name : {std::string(), std::string(256, 'a')}) {
        const std::size_t messages = front_end.messages().size();
        entered.name = name;
        EXPECT_EQ(CQuarnCommand::cancel, confirm());
        ASSERT_EQ(messages + 1, front_end.messages().size());
        EXPECT_EQ(L"Failed. Invalid animation name\n", front_end.messages().back().text);
        EXPECT_EQ(L"Animation", front_end.messages().back().title);
        EXPECT_EQ(0U, front_end.messages().back().flags);
        expectRecordUntouched();
    }
}

TEST_P(PathDialog, PickThatFailsShowsNoDialog) {
    enterIntoDialog(entered);
    answer({L"_Cancel"});
    EXPECT_EQ(CQuarnCommand::cancel,
              session->runCommand(GetParam() == Following::path ? L"SetPathAnimation"
                                                                : L"SetFlythroughAnimation",
                                  true));
    EXPECT_EQ("", shownDialog());
    expectRecordUntouched();
}

TEST_P(PathDialog, AsksForNothingButTheObjects) {
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(GetParam() == Following::path ? 2U : 1U, front_end.questions().size());
}

TEST_P(PathWithoutDialogPlugIn, IsToldAndFails) {
    EXPECT_EQ(CQuarnCommand::failure, runInteractively());
    ASSERT_EQ(1U, front_end.messages().size());
    EXPECT_EQ(L"Vex UI (ZEL_VexUI.qnp) cannot be loaded.", front_end.messages()[0].text);
    EXPECT_EQ(L"Animation", front_end.messages()[0].title);
    EXPECT_EQ(48U, front_end.messages()[0].flags);
    expectRecordUntouched();
}

TEST_P(PathWithoutItsDialog, FailsWithoutAWord) {
    EXPECT_EQ(CQuarnCommand::failure, runInteractively());
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
    EXPECT_TRUE(front_end.messages().empty());
    expectRecordUntouched();
}

TEST_F(PathDialogOnly, TakesTheObjectsAndTheEnteredFrames) {
    ASSERT_EQ(CQuarnCommand::success, pathInDialog(L"rail", L"spot", {.frames = 3}));
    EXPECT_EQ(KM_3dmAnimationProperties::path, record().CaptureType());
    EXPECT_EQ(objectId(L"rail"), record().CameraPathId());
    EXPECT_EQ(objectId(L"spot"), record().TargetPathId());
    EXPECT_EQ(KM_3dPointArray({{0.0, 0.0, 1.0}, {5.0, 0.0, 1.0}, {10.0, 0.0, 1.0}}),
              record().CameraPoints());
}

TEST_F(PathDialogOnly, OffersOneFrameBetweenTwoPointsAndKeepsTheRecordsCountWhenCancelled) {
    record().SetFrameCount(42);
    ASSERT_EQ(CQuarnCommand::cancel, pathInDialog(L"nest", L"spot", {.confirmed = false}));
    EXPECT_THAT(shownInDialog(), testing::StartsWith("frames=1;"));
    EXPECT_EQ(42, record().FrameCount());
    ASSERT_EQ(CQuarnCommand::success, pathInDialog(L"nest", L"spot", {.frames = std::nullopt}));
    EXPECT_EQ(1, record().FrameCount());
    EXPECT_EQ(1, record().CameraPoints().Count());
}

TEST_F(PathDialogOnly, NoFramesBetweenTwoPointsMakeAnAnimationThatCannotBePlayed) {
    ASSERT_EQ(CQuarnCommand::success, pathInDialog(L"nest", L"spot", {.frames = 0}));
    EXPECT_EQ(0, record().FrameCount());
    EXPECT_EQ(1, record().CameraPoints().Count());
    EXPECT_EQ(1, record().TargetPoints().Count());
    EXPECT_EQ(CQuarnCommand::failure, run(L"PlayAnimation"));
    EXPECT_THAT(printed(), HasSubstr(L"No animation is currently set. There is nothing to view\n"));
}

TEST_F(PathDialogOnly, NoFramesOnATargetCurveCannotBeDivided) {
    EXPECT_EQ(CQuarnCommand::failure, pathInDialog(L"nest", L"gaze", {.frames = 0}));
    EXPECT_THAT(printed(), HasSubstr(L"Failed to divide target path. Nothing done\n"));
    expectRecordUntouched();
}

TEST_F(PathDialogOnly, CurvesThatCannotBeDividedFailAfterTheDialog) {
    addCurve(L"void", curveWithoutPoints());
    EXPECT_EQ(CQuarnCommand::failure, pathInDialog(L"void", L"gaze", {}));
    EXPECT_THAT(printed(), HasSubstr(L"Failed to divide camera path. Nothing done\n"));
    EXPECT_EQ(CQuarnCommand::failure, pathInDialog(L"rail", L"void", {}));
    EXPECT_THAT(printed(), HasSubstr(L"Failed to divide target path. Nothing done\n"));
    expectRecordUntouched();
}

TEST_F(FlythroughDialogOnly, TakesTheCurveAndTheEnteredFrames) {
    ASSERT_EQ(CQuarnCommand::success, flythroughInDialog(L"rail", {.frames = 2}));
    EXPECT_EQ(KM_3dmAnimationProperties::flythrough, record().CaptureType());
    EXPECT_EQ(objectId(L"rail"), record().CameraPathId());
    EXPECT_EQ(objectId(L"rail"), record().TargetPathId());
    EXPECT_EQ(KM_3dPointArray({{0.0, 0.0, 1.0}, {5.0, 0.0, 1.0}}), record().CameraPoints());
    EXPECT_EQ(KM_3dPointArray({{5.0, 0.0, 1.0}, {10.0, 0.0, 1.0}}), record().TargetPoints());
}

TEST_F(FlythroughDialogOnly, CurveThatCannotBeDividedFailsAfterTheDialog) {
    addCurve(L"void", curveWithoutPoints());
    EXPECT_EQ(CQuarnCommand::failure, flythroughInDialog(L"void", {}));
    EXPECT_THAT(printed(), HasSubstr(L"Failed to divide camera path. Nothing done\n"));
    expectRecordUntouched();
}
