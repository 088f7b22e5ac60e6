#include "host/commands/RenderSettingsForm.h"
#include "host/commands/ViewportSizeForm.h"
#include "tests/host/commands/HostFormFixture.h"
#include "tests/support/TempFolder.h"

namespace quarn::test {
namespace {

using Size = ViewportSizeForm;
using Settings = RenderSettingsForm;

class PictureSizeForm : public FormTest {
protected:
    RenderSettings& settings() { return document().renderWindow().settings; }
};

TEST_F(PictureSizeForm, SizesTheViewThatItShowsTheSizeOf) {
    view().setFrameSize(640, 360);
    const auto ended = answer(L"_ViewportSize", [](HeadlessDialogWindow& form) {
        EXPECT_EQ(form.form().title.View(), L"Viewport Size");
        EXPECT_EQ(form.text(Size::width_id), L"640");
        EXPECT_EQ(form.text(Size::height_id), L"360");
        form.type(Size::width_id, L"800");
        form.type(Size::height_id, L"450");
        form.pressOk();
    });
    EXPECT_EQ(ended, CQuarnCommand::success);
    EXPECT_EQ(view().frameWidth(), 800);
    EXPECT_EQ(view().frameHeight(), 450);
    EXPECT_TRUE(front_end.questions().empty());
}

TEST_F(PictureSizeForm, ClosedFormCancelsTheCommandAndChangesNothing) {
    view().setFrameSize(640, 360);
    const RenderSettings before = settings();
    for (const wchar_t* line : {L"_ViewportSize", L"_RenderSettings"}) {
        const auto ended = answer(line, [](HeadlessDialogWindow& form) {
            form.type(Size::width_id, L"800");
            form.pressClose();
        });
        EXPECT_EQ(ended, CQuarnCommand::cancel);
    }
    EXPECT_EQ(view().frameWidth(), 640);
    EXPECT_EQ(settings(), before);
    EXPECT_EQ(printed(), "");
}

TEST_F(PictureSizeForm, RefusesSidesThatNoPictureHas) {
    for (const wchar_t* line : {L"_ViewportSize", L"_RenderSettings"})
        for (const int side : {Size::width_id, Size::height_id}) {
            for (const wchar_t* text : {L"0", L"-5", L"16385"})
                EXPECT_EQ(refusal(line, side, text), L"Enter a number between 1 and 16384");
            EXPECT_EQ(refusal(line, side, L"12.5"), L"Enter a whole number");
        }
}

TEST_F(PictureSizeForm, TakesTheLimits) {
    answer(L"_RenderSettings", [](HeadlessDialogWindow& form) {
        form.type(Settings::width_id, L"16384");
        form.type(Settings::height_id, L"1");
        form.type(Settings::samples_id, L"16384");
        form.type(Settings::preview_samples_id, L"1");
        form.pressOk();
    });
    EXPECT_EQ(settings(), (RenderSettings{16384, 1, 16384, 1}));
}

TEST_F(PictureSizeForm, SettingsFormShowsTheSettingsAndRefusesSamplesOutOfRange) {
    settings() = {320, 200, 100, 4};
    answer(L"_RenderSettings", [](HeadlessDialogWindow& form) {
        EXPECT_EQ(form.form().title.View(), L"Render Settings");
        EXPECT_EQ(form.text(Settings::width_id), L"320");
        EXPECT_EQ(form.text(Settings::height_id), L"200");
        EXPECT_EQ(form.text(Settings::samples_id), L"100");
        EXPECT_EQ(form.text(Settings::preview_samples_id), L"4");
    });
    for (const int samples : {Settings::samples_id, Settings::preview_samples_id})
        for (const wchar_t* text : {L"0", L"16385"})
            EXPECT_EQ(refusal(L"_RenderSettings", samples, text),
                      L"Enter a number between 1 and 16384");
    EXPECT_EQ(settings(), (RenderSettings{320, 200, 100, 4}));
}

TEST_F(PictureSizeForm, ButtonFillsInTheSizeOfTheView) {
    view().setFrameSize(1000, 700);
    answer(L"_RenderSettings", [](HeadlessDialogWindow& form) {
        EXPECT_TRUE(form.click(Settings::view_size_id));
        EXPECT_EQ(form.text(Settings::width_id), L"1000");
        form.pressOk();
    });
    EXPECT_EQ(settings().width_px, 1000);
    EXPECT_EQ(settings().height_px, 700);
    EXPECT_EQ(settings().samples, RenderSettings().samples);
}

TEST_F(PictureSizeForm, LineWithWordsAsksWithoutAForm) {
    EXPECT_EQ(session.runCommand(L"_ViewportSize 320 240", true), CQuarnCommand::success);
    EXPECT_EQ(view().frameWidth(), 320);
    EXPECT_EQ(session.runCommand(L"_RenderSettings _Samples 5 _Enter", true),
              CQuarnCommand::success);
    EXPECT_EQ(settings().samples, 5);
    EXPECT_TRUE(front_end.dialogs().empty());
}

TEST_F(PictureSizeForm, ScriptAsksWithoutAForm) {
    for (const wchar_t* line : {L"_ViewportSize", L"_RenderSettings", L"_Camera", L"_Sun"}) {
        session.runCommand(line);
        session.runCommand((std::wstring(L"-") + line).c_str(), true);
    }
    EXPECT_TRUE(front_end.dialogs().empty());
    EXPECT_EQ(front_end.questions().size(), 8U);
}

TEST_F(PictureSizeForm, PromptsAskWithoutAWordWhereThereAreNoDialogs) {
    front_end.addAnswer(L"320");
    front_end.addAnswer(L"240");
    EXPECT_EQ(session.runCommand(L"_ViewportSize", true), CQuarnCommand::success);
    EXPECT_EQ(view().frameHeight(), 240);
    EXPECT_EQ(printed(), "");
}

TEST(MissingForm, IsToldAndThePromptsAsk) {
    const TempFolder without_forms;
    ScriptedFrontEnd front_end;
    SessionOptions options;
    options.language = "C";
    options.dialog_folders = {without_forms.path()};
    Session session(front_end, options);
    front_end.addAnswer(L"320");
    front_end.addAnswer(L"240");
    EXPECT_EQ(session.runCommand(L"_ViewportSize", true), CQuarnCommand::success);
    EXPECT_THAT(KM_wString(front_end.printed()).ToUtf8(),
                testing::HasSubstr("There is no dialog template 4204.dialog.json in "));
    EXPECT_EQ(front_end.questions().size(), 2U);
}

} // namespace
} // namespace quarn::test
