#include "sdk/vexui/VexUi.h"
#include "tests/zoetrix/fixtures/TurntableFixture.h"

using testing::HasSubstr;

namespace {

class TurntableDialog : public TurntableFixture {
protected:
    CQuarnCommand::result confirm() { return runInDialog(entered); }
    void expectRecordUntouched() {
        EXPECT_EQ(KM_3dmAnimationProperties::none, record().CaptureType());
        EXPECT_EQ(L"Walk", record().HtmlFilename().View());
        EXPECT_TRUE(record().CameraPoints().IsEmpty());
    }

    Entered entered;
};

class NoDialogPlugIn : public PlugInFixture {};
class PlugInWithoutDialogs : public PlugInFixture {
protected:
    PlugInWithoutDialogs() : PlugInFixture("no-dialogs") {}
};
class UnansweredDialog : public TurntableFixture {
protected:
    void SetUp() override {}
};

} // namespace

TEST_F(TurntableDialog, ShowsTheChoicesAndTheRecord) {
    record().SetFrameCount(33);
    record().SetFileExtension(L"tga");
    record().SetCaptureMethod(L"XRay");
    record().SetViewportName(L"Right");
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ("frames=33;name=Walk;files=jpg,bmp,png,tga@3;"
              "captures=RenderFull,RenderPreview,Wireframe,Shaded,RenderedViewport,Translucent,"
              "XRay,Drawing,Clay@6;viewports=Top,Front,Right,Perspective@2;"
              "directions=Clockwise,AntiClockwise@0",
              shownInDialog());
    EXPECT_EQ("turntable", shownDialog());
    EXPECT_TRUE(front_end.questions().empty());
}

TEST_F(TurntableDialog, StoresWhatWasChosen) {
    entered = {.file_type = 2, .method = 4, .viewport = 1, .frames = 8, .name = "Spin"};
    ASSERT_EQ(CQuarnCommand::success, confirm());
    const KM_3dmAnimationProperties& props = record();
    EXPECT_EQ(KM_3dmAnimationProperties::turntable, props.CaptureType());
    EXPECT_EQ(8, props.FrameCount());
    EXPECT_EQ(0, props.CurrentFrame());
    EXPECT_EQ(8, props.CameraPoints().Count());
    EXPECT_EQ(8, props.TargetPoints().Count());
    EXPECT_TRUE(near(props.CameraPoints()[7], eye, 0.0));
    EXPECT_EQ(L"png", props.FileExtension().View());
    EXPECT_EQ(L"RenderedViewport", props.CaptureMethod().View());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(), props.DisplayMode());
    EXPECT_EQ(L"Front", props.ViewportName().View());
    EXPECT_EQ(L"Spin", props.HtmlFilename().View());
    EXPECT_TRUE(front_end.messages().empty());
}

TEST_F(TurntableDialog, OneFrameIsTheCameraItself) {
    entered.frames = 1;
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(KM_3dPointArray({eye}), record().CameraPoints());
    EXPECT_EQ(KM_3dPointArray({target}), record().TargetPoints());
}

TEST_F(TurntableDialog, FrameCountsBelowOneCannotBeDivided) {
    for (const int frames : {0, -5}) {
        entered.frames = frames;
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::failure, confirm());
        EXPECT_THAT(printed(), HasSubstr(L"Failed to divide camera path. Nothing done\n"));
        expectRecordUntouched();
    }
}

TEST_F(TurntableDialog, RenderMethodsSetTheirFlagsAndKeepTheMode) {
    const KM_UUID mode = CQuarnDisplayAttrsMgr::RenderedModeId();
    record().SetDisplayMode(mode);
    entered.method = 0;
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(L"RenderFull", record().CaptureMethod().View());
    EXPECT_TRUE(record().RenderFull());
    EXPECT_FALSE(record().RenderPreview());
    EXPECT_EQ(mode, record().DisplayMode());

    entered.method = 1;
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(L"RenderPreview", record().CaptureMethod().View());
    EXPECT_FALSE(record().RenderFull());
    EXPECT_TRUE(record().RenderPreview());
    EXPECT_EQ(mode, record().DisplayMode());

    entered.method = 2;
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(L"Wireframe", record().CaptureMethod().View());
    EXPECT_FALSE(record().RenderFull());
    EXPECT_FALSE(record().RenderPreview());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::WireframeModeId(), record().DisplayMode());
}

TEST_F(TurntableDialog, SelectionsOutsideTheirListsChangeNothing) {
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

TEST_F(TurntableDialog, EachSelectionIsMeasuredAgainstItsOwnList) {
    ASSERT_EQ(CQuarnCommand::success, run(L"AddView Side Front"));
    record().SetFileExtension(L"bmp");
    // Behind the last file type and the last capture method, but not behind the last of five views.
    entered = {.file_type = 4, .method = 9, .viewport = 4};
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(L"bmp", record().FileExtension().View());
    EXPECT_EQ(L"Shaded", record().CaptureMethod().View());
    EXPECT_EQ(L"Side", record().ViewportName().View());
    entered = {.file_type = 3, .method = 8, .viewport = 5};
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(L"tga", record().FileExtension().View());
    EXPECT_EQ(L"Clay", record().CaptureMethod().View());
    EXPECT_EQ(L"Side", record().ViewportName().View());
}

TEST_F(TurntableDialog, RenderMethodsThatAreKeptAreKnownInAnyCase) {
    entered.method = -1;
    record().SetCaptureMethod(L"renderFULL");
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_TRUE(record().RenderFull());
    EXPECT_FALSE(record().RenderPreview());
    record().SetCaptureMethod(L"renderPREVIEW");
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_FALSE(record().RenderFull());
    EXPECT_TRUE(record().RenderPreview());
    EXPECT_EQ(L"renderPREVIEW", record().CaptureMethod().View());
}

TEST_F(TurntableDialog, IsNotOpenedForACameraAboveItsTarget) {
    KM_Viewport camera = view(L"Perspective").MainViewport().VP();
    ASSERT_TRUE(camera.SetCameraDirection({0.0, 1.0, -5.0}));
    ASSERT_TRUE(camera.SetCameraLocation({2.0, 0.0, 9.0}));
    ASSERT_TRUE(camera.SetTargetPoint({2.0, 0.0, 0.0}));
    ASSERT_TRUE(view(L"Perspective").MainViewport().SetVP(camera, true, true));
    forgetDialog();
    EXPECT_EQ(CQuarnCommand::failure, confirm());
    EXPECT_EQ("", shownDialog());
    EXPECT_EQ(L"Failed to create valid camera path in this view. Nothing done\n", printed());
    expectRecordUntouched();
}

TEST_F(TurntableDialog, ChoosesTheDirectionBothWays) {
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"AntiClockwise"));
    const KM_3dPointArray anticlockwise = record().CameraPoints();
    entered.frames = 4;
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_TRUE(shownInDialog().ends_with("@1")) << shownInDialog();
    EXPECT_EQ(anticlockwise, record().CameraPoints());

    entered.direction = 0;
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_NE(anticlockwise, record().CameraPoints());
    const KM_3dPointArray clockwise = record().CameraPoints();
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"_Enter"));
    EXPECT_EQ(clockwise, record().CameraPoints());

    entered.direction = 1;
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(anticlockwise, record().CameraPoints());
}

TEST_F(TurntableDialog, ClosedUnconfirmedLeavesEverythingAsItWas) {
    entered = {.file_type = 2, .direction = 1, .name = "a<b", .confirmed = false};
    EXPECT_EQ(CQuarnCommand::cancel, confirm());
    expectRecordUntouched();
    EXPECT_TRUE(front_end.messages().empty()) << "a name that is given up is not repaired";
    entered = {};
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_TRUE(shownInDialog().ends_with("@0")) << shownInDialog();
}

TEST_F(TurntableDialog, InvalidNameIsRepairedAndTold) {
    entered.name = "a<b>%s";
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(L"a_b_%s", record().HtmlFilename().View());
    ASSERT_EQ(1U, front_end.messages().size());
    EXPECT_EQ(L"The following characters cannot be used in the animation name: \\ / : * ? \" < > "
              L"| . The name was changed from (a<b>%s) to (a_b_%s). ",
              front_end.messages()[0].text);
    EXPECT_EQ(L"Animation", front_end.messages()[0].title);
    EXPECT_EQ(0U, front_end.messages()[0].flags);
}

TEST_F(TurntableDialog, NameThatCannotBeRepairedEndsIt) {
    for (const std::string& name : {std::string(), std::string(256, 'a')}) {
        const std::size_t messages = front_end.messages().size();
        entered.name = name;
        entered.direction = 1;
        EXPECT_EQ(CQuarnCommand::cancel, confirm());
        ASSERT_EQ(messages + 1, front_end.messages().size());
        EXPECT_EQ(L"Failed. Invalid animation name\n", front_end.messages().back().text);
        EXPECT_EQ(L"Animation", front_end.messages().back().title);
        EXPECT_EQ(0U, front_end.messages().back().flags);
        expectRecordUntouched();
    }
    entered = {};
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_TRUE(shownInDialog().ends_with("@0")) << shownInDialog();
}

TEST_F(TurntableDialog, NameOf255CharactersIsTakenAsItIs) {
    entered.name = std::string(255, 'a');
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(entered.name, record().HtmlFilename().ToUtf8());
}

TEST_F(NoDialogPlugIn, IsToldAndFails) {
    EXPECT_EQ(CQuarnCommand::failure, session->runCommand(L"SetTurntableAnimation", true));
    ASSERT_EQ(1U, front_end.messages().size());
    EXPECT_EQ(L"Vex UI (ZEL_VexUI.qnp) cannot be loaded.", front_end.messages()[0].text);
    EXPECT_EQ(48U, front_end.messages()[0].flags);
    EXPECT_EQ(KM_3dmAnimationProperties::none, record().CaptureType());
}

TEST_F(PlugInWithoutDialogs, FailsWithoutAWord) {
    EXPECT_EQ(CQuarnCommand::failure, session->runCommand(L"SetTurntableAnimation", true));
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
    EXPECT_TRUE(front_end.messages().empty());
    EXPECT_EQ(KM_3dmAnimationProperties::none, record().CaptureType());
}

TEST_F(UnansweredDialog, IsLoadedByTheCommandAndCancelsIt) {
    placeCamera(L"Perspective", eye, target);
    EXPECT_FALSE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
    EXPECT_EQ(CQuarnCommand::cancel, runInDialog({.confirmed = false}));
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
}
