#include "tests/zoetrix/TurntableFixture.h"

using testing::HasSubstr;

namespace {

using Names = KM_ClassArray<KM_wString>;

/// What the dialog was given when it opened.
struct Opened {
    Names files, methods, views, directions;
    int file = -1, method = -1, view = -1, direction = -1;
    KM_3dmAnimationProperties record;
};
Opened opened;

/// What the person enters. A selection that is not set is left alone.
struct Entered {
    std::optional<int> file, method, view, direction;
    int frames = 12;
    KM_wString name = L"Walk";
    bool confirmed = true;
};
Entered entered;

bool dialog(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    opened = {lists.FileList(),
              lists.CaptureList(),
              lists.ViewportList(),
              lists.DirectionList(),
              lists.FileListSelection(),
              lists.CaptureListSelection(),
              lists.ViewportListSelection(),
              lists.DirectionListSelection(),
              record};
    if (entered.file)
        lists.SetFileListSelection(*entered.file);
    if (entered.method)
        lists.SetCaptureListSelection(*entered.method);
    if (entered.view)
        lists.SetViewportListSelection(*entered.view);
    if (entered.direction)
        lists.SetDirectionListSelection(*entered.direction);
    record.SetFrameCount(entered.frames);
    record.SetHtmlFilename(entered.name);
    // Nothing else of the record counts.
    record.SetFileExtension(L"gif");
    record.SetViewportName(L"Nowhere");
    record.SetCaptureMethod(L"Nothing");
    record.SetCaptureType(KM_3dmAnimationProperties::seasonal_sun);
    return entered.confirmed;
}

class TurntableDialog : public TurntableFixture {
protected:
    void SetUp() override {
        TurntableFixture::SetUp();
        entered = {};
        opened = {};
    }
    CQuarnCommand::result confirm() { return runInDialog(dialog); }
    void expectRecordUntouched() {
        EXPECT_EQ(KM_3dmAnimationProperties::none, record().CaptureType());
        EXPECT_EQ(L"Walk", record().HtmlFilename().View());
        EXPECT_TRUE(record().CameraPoints().IsEmpty());
    }
};

class NoDialogPlugIn : public PlugInFixture {};
class PlugInWithoutDialogs : public PlugInFixture {
protected:
    PlugInWithoutDialogs() : PlugInFixture("no-dialogs") {}
};
class UnansweredDialog : public PlugInFixture {
protected:
    UnansweredDialog() : PlugInFixture("dialogs") {}
};

KM_wString repeated(wchar_t character, std::size_t count) {
    return KM_wString(std::wstring(count, character));
}

} // namespace

TEST_F(TurntableDialog, ShowsTheChoicesAndTheRecord) {
    record().SetFrameCount(33);
    record().SetFileExtension(L"tga");
    record().SetCaptureMethod(L"XRay");
    record().SetViewportName(L"Right");
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(Names({L"jpg", L"bmp", L"png", L"tga"}), opened.files);
    EXPECT_EQ(Names({L"Top", L"Front", L"Right", L"Perspective"}), opened.views);
    EXPECT_EQ(Names({L"Clockwise", L"AntiClockwise"}), opened.directions);
    EXPECT_EQ(L"XRay", opened.methods[opened.method].View());
    EXPECT_EQ(3, opened.file);
    EXPECT_EQ(2, opened.view);
    EXPECT_EQ(0, opened.direction);
    EXPECT_EQ(33, opened.record.FrameCount());
    EXPECT_TRUE(front_end.questions().empty());
}

TEST_F(TurntableDialog, StoresWhatWasChosen) {
    entered = {.file = 2, .method = 4, .view = 1, .frames = 8, .name = L"Spin"};
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
        entered.file = entered.method = entered.view = selection;
        ASSERT_EQ(CQuarnCommand::success, confirm());
        EXPECT_EQ(L"bmp", record().FileExtension().View());
        EXPECT_EQ(L"Shaded", record().CaptureMethod().View());
        EXPECT_EQ(L"Top", record().ViewportName().View());
        EXPECT_EQ(mode, record().DisplayMode());
    }
}

TEST_F(TurntableDialog, ChoosesTheDirectionBothWays) {
    ASSERT_EQ(CQuarnCommand::success, runAtCommandLine(L"4", L"AntiClockwise"));
    const KM_3dPointArray anticlockwise = record().CameraPoints();
    entered.frames = 4;
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(1, opened.direction);
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
    entered = {.file = 2, .direction = 1, .confirmed = false};
    EXPECT_EQ(CQuarnCommand::cancel, confirm());
    expectRecordUntouched();
    entered = {};
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(0, opened.direction);
}

TEST_F(TurntableDialog, InvalidNameIsRepairedAndTold) {
    entered.name = L"a<b>%s";
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
    for (const KM_wString& name : {KM_wString(), repeated(L'a', 256)}) {
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
    EXPECT_EQ(0, opened.direction);
}

TEST_F(TurntableDialog, NameOf255CharactersIsTakenAsItIs) {
    entered.name = repeated(L'a', 255);
    ASSERT_EQ(CQuarnCommand::success, confirm());
    EXPECT_EQ(entered.name, record().HtmlFilename());
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
    EXPECT_EQ(CQuarnCommand::cancel, session->runCommand(L"SetTurntableAnimation", true));
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
}
