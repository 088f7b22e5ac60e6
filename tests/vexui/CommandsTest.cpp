#include "tests/vexui/VexUiFixture.h"

using testing::HasSubstr;

// The commands of the animation plug-in, with their forms, as a person runs them in the window.

namespace {

class CommandsWithForms : public VexUiFixture {
protected:
    CQuarnCommand::result run(const wchar_t* command, Person person) {
        next(std::move(person));
        return session->runCommand(command, true);
    }
    void storeName(const wchar_t* name) {
        KM_3dmAnimationProperties changed = stored();
        changed.SetHtmlFilename(name);
        session->document().Properties().SetAnimationProperties(changed);
    }
};

} // namespace

TEST_F(CommandsWithForms, ATurntableIsSetUpAsItWasEntered) {
    EXPECT_EQ(CQuarnCommand::success, run(L"SetTurntableAnimation", [](QDialog& form) {
                  EXPECT_EQ("turntableForm", form.objectName().toStdString());
                  typeInto(form, "frames", "8");
                  choose(form, "fileType", 2);
                  choose(form, "captureMethod", 3);
                  choose(form, "viewport", 1);
                  typeInto(form, "name", "Spin");
                  press(form, Qt::Key_Return);
              }));
    EXPECT_EQ(KM_3dmAnimationProperties::turntable, stored().CaptureType());
    EXPECT_EQ(8, stored().FrameCount());
    EXPECT_EQ(8, stored().CameraPoints().Count());
    EXPECT_EQ(L"png", stored().FileExtension().View());
    EXPECT_EQ(L"Shaded", stored().CaptureMethod().View());
    EXPECT_EQ(L"Front", stored().ViewportName().View());
    EXPECT_EQ(L"Spin", stored().HtmlFilename().View());
}

TEST_F(CommandsWithForms, EscapeEndsTheCommandAndKeepsTheRecord) {
    storeName(L"Before");
    for (const wchar_t* command :
         {L"SetTurntableAnimation", L"SetOneDaySunAnimation", L"SetSeasonalSunAnimation"}) {
        EXPECT_EQ(CQuarnCommand::cancel, run(command, [](QDialog& form) {
                      typeInto(form, "name", "After");
                      press(form, Qt::Key_Escape);
                  }));
        EXPECT_EQ(L"Before", stored().HtmlFilename().View());
        EXPECT_EQ(KM_3dmAnimationProperties::none, stored().CaptureType());
    }
}

TEST_F(CommandsWithForms, ANameWithForbiddenCharactersIsRepairedAndTold) {
    EXPECT_EQ(CQuarnCommand::success, run(L"SetTurntableAnimation", [](QDialog& form) {
                  typeInto(form, "name", "a/b:c");
                  press(form, Qt::Key_Return);
              }));
    EXPECT_EQ(L"a_b_c", stored().HtmlFilename().View());
    ASSERT_EQ(1u, front_end.messages().size());
    EXPECT_THAT(front_end.messages()[0].text, HasSubstr(L"from (a/b:c) to (a_b_c)"));
}

TEST_F(CommandsWithForms, ADayHasTheFramesThatItsFormPromised) {
    storeName(L"Day");
    std::string promised;
    EXPECT_EQ(CQuarnCommand::success, run(L"SetOneDaySunAnimation", [&](QDialog& form) {
                  field<QDateEdit>(form, "date").setDate({2010, 6, 1});
                  field<QTimeEdit>(form, "startTime").setTime({6, 0});
                  field<QTimeEdit>(form, "endTime").setTime({18, 0});
                  typeInto(form, "minutes", "50");
                  promised = lineOf(form);
                  click(form, "ok");
              }));
    // 720 minutes hold 14 steps of 50; the last ends at 17:40.
    EXPECT_EQ("15 frames, the first at 06:00, the last at 17:40.", promised);
    EXPECT_EQ(KM_3dmAnimationProperties::one_day_sun, stored().CaptureType());
    EXPECT_EQ(15, stored().FrameCount());
    EXPECT_EQ(L"2010-06-01 17:40:00", (*stored().Dates().At(14)).View());
}

TEST_F(CommandsWithForms, ASeasonHasTheFramesThatItsFormPromised) {
    storeName(L"Season");
    std::string promised;
    EXPECT_EQ(CQuarnCommand::success, run(L"SetSeasonalSunAnimation", [&](QDialog& form) {
                  field<QDateEdit>(form, "startDate").setDate({2026, 3, 21});
                  field<QDateEdit>(form, "endDate").setDate({2026, 12, 21});
                  field<QTimeEdit>(form, "timeOfDay").setTime({14, 30});
                  typeInto(form, "days", "7");
                  promised = lineOf(form);
                  click(form, "ok");
              }));
    // 275 days lie between the dates: 39 steps of 7 days, the last on 19 December.
    EXPECT_EQ("40 frames, the first on 2026-03-21, the last on 2026-12-19.", promised);
    EXPECT_EQ(KM_3dmAnimationProperties::seasonal_sun, stored().CaptureType());
    EXPECT_EQ(40, stored().FrameCount());
    EXPECT_EQ(L"2026-12-19 14:30:00", (*stored().Dates().At(39)).View());
}

TEST_F(CommandsWithForms, APathIsSetUpAsItWasEntered) {
    ASSERT_EQ(CQuarnCommand::success, session->runCommand(L"Line 0,0,5 10,0,5"));
    ASSERT_EQ(CQuarnCommand::success, session->runCommand(L"Rename Curve Walk"));
    front_end.addAnswer(L"Walk");
    EXPECT_EQ(CQuarnCommand::success, run(L"SetFlythroughAnimation", [](QDialog& form) {
                  EXPECT_EQ("pathForm", form.objectName().toStdString());
                  typeInto(form, "frames", "5");
                  typeInto(form, "name", "Fly");
                  press(form, Qt::Key_Return);
              }));
    EXPECT_EQ(KM_3dmAnimationProperties::flythrough, stored().CaptureType());
    EXPECT_EQ(5, stored().FrameCount());
    EXPECT_EQ(L"Fly", stored().HtmlFilename().View());
}
