#include "sdk/vexui/VexUi.h"
#include "tests/zoetrix/fixtures/SunFixture.h"

using testing::ElementsAre;
using testing::HasSubstr;

namespace {

using Record = KM_3dmAnimationProperties;

class SunDialog : public SunFixture {
protected:
    /// What a person enters into the dialog of the study of one day, and of a season.
    Entered day = {.name = "Shadow",
                   .place = "51.5 -0.12 12.5",
                   .start = "2026 6 21 6 0 0",
                   .end = "2026 6 21 9 30 0",
                   .minutes = 60};
    Entered season = {.name = "Shadow",
                      .place = "51.5 -0.12 12.5",
                      .start = "2026 6 21 14 30 0",
                      .end = "2026 6 30 14 30 0",
                      .days = 3};
    /// Runs both commands with the same choices and looks at the record after each.
    void inBoth(const std::function<void(Entered&)>& enter, const std::function<void()>& look) {
        enter(day);
        ASSERT_EQ(CQuarnCommand::success, dayInDialog(day));
        look();
        enter(season);
        ASSERT_EQ(CQuarnCommand::success, seasonInDialog(season));
        look();
    }
};

class SunCommandsWithoutPlugIn : public SunFixture {
protected:
    SunCommandsWithoutPlugIn() : SunFixture("") {}
};
class SunCommandsWithoutDialogs : public SunFixture {
protected:
    SunCommandsWithoutDialogs() : SunFixture("no-dialogs") {}
};

} // namespace

TEST_F(SunDialog, ShowsTheChoicesAndTheRecord) {
    record().SetFrameCount(33);
    record().SetFileExtension(L"tga");
    record().SetCaptureMethod(L"RenderedViewport");
    record().SetViewportName(L"Right");
    const std::string shown = "frames=33;name=Sun;files=jpg,bmp,png,tga@3;"
                              "captures=RenderFull,RenderPreview,RenderedViewport,Clay@2;"
                              "viewports=Top,Front,Right,Perspective@2;directions=@0";
    const std::string sun_shown = "place=40,10,5;start=2010-6-1 6:0:0;end=2015-4-3 18:0:59;"
                                  "minutes=30;days=30";
    day.confirmed = season.confirmed = false;
    EXPECT_EQ(CQuarnCommand::cancel, dayInDialog(day));
    EXPECT_EQ("day", shownDialog());
    EXPECT_EQ(shown, shownInDialog());
    EXPECT_EQ(sun_shown, sunShownInDialog());
    forgetDialog();
    EXPECT_EQ(CQuarnCommand::cancel, seasonInDialog(season));
    EXPECT_EQ("season", shownDialog());
    EXPECT_EQ(shown, shownInDialog());
    EXPECT_EQ(sun_shown, sunShownInDialog());
    EXPECT_TRUE(front_end.questions().empty());
    EXPECT_TRUE(front_end.messages().empty());
}

TEST_F(SunDialog, StoresTheDay) {
    day.start = "2026 6 21 6 0 15";
    day.end = "2026 6 21 9 30 45";
    ASSERT_EQ(CQuarnCommand::success, dayInDialog(day));
    const Record& props = record();
    EXPECT_EQ(Record::one_day_sun, props.CaptureType());
    EXPECT_EQ(0, props.CurrentFrame());
    EXPECT_EQ(51.5, props.Latitude());
    EXPECT_EQ(-0.12, props.Longitude());
    EXPECT_EQ(12.5, props.NorthAngle());
    EXPECT_EQ(21, props.StartDay());
    EXPECT_EQ(6, props.StartMonth());
    EXPECT_EQ(2026, props.StartYear());
    EXPECT_EQ(6, props.StartHour());
    EXPECT_EQ(0, props.StartMinutes());
    EXPECT_EQ(15, props.StartSeconds());
    EXPECT_EQ(9, props.EndHour());
    EXPECT_EQ(30, props.EndMinutes());
    EXPECT_EQ(45, props.EndSeconds());
    EXPECT_EQ(60, props.MinutesBetweenFrames());
    EXPECT_EQ(30, props.DaysBetweenFrames());
    EXPECT_EQ(L"Shadow", props.HtmlFilename().View());
    EXPECT_THAT(dates(), ElementsAre(L"2026-06-21 06:00:15", L"2026-06-21 07:00:15",
                                     L"2026-06-21 08:00:15", L"2026-06-21 09:00:15"));
}

TEST_F(SunDialog, TheDaysEndDateCountsForTheFramesAndIsNotStored) {
    day.end = "2026 6 22 2 0 0";
    day.minutes = 300;
    ASSERT_EQ(CQuarnCommand::success, dayInDialog(day));
    expectFrames({{2026, 6, 21, 6},
                  {2026, 6, 21, 11},
                  {2026, 6, 21, 16},
                  {2026, 6, 21, 21},
                  {2026, 6, 22, 2}},
                 12.5, 51.5, -0.12);
    EXPECT_EQ(3, record().EndDay());
    EXPECT_EQ(4, record().EndMonth());
    EXPECT_EQ(2015, record().EndYear());
    EXPECT_EQ(2, record().EndHour());
}

TEST_F(SunDialog, StoresTheSeason) {
    record().SetEndHour(19);
    record().SetEndMinutes(17);
    record().SetEndSeconds(41);
    season.end = "2026 6 30 15 31 16";
    ASSERT_EQ(CQuarnCommand::success, seasonInDialog(season));
    const Record& props = record();
    EXPECT_EQ(Record::seasonal_sun, props.CaptureType());
    EXPECT_EQ(0, props.CurrentFrame());
    EXPECT_EQ(51.5, props.Latitude());
    EXPECT_EQ(-0.12, props.Longitude()) << "the dialog is not bound to the question's limits";
    EXPECT_EQ(12.5, props.NorthAngle());
    EXPECT_EQ(21, props.StartDay());
    EXPECT_EQ(30, props.EndDay());
    EXPECT_EQ(6, props.EndMonth());
    EXPECT_EQ(2026, props.EndYear());
    EXPECT_EQ(14, props.StartHour());
    EXPECT_EQ(30, props.StartMinutes());
    EXPECT_EQ(0, props.StartSeconds());
    EXPECT_EQ(19, props.EndHour());
    EXPECT_EQ(17, props.EndMinutes());
    EXPECT_EQ(41, props.EndSeconds());
    EXPECT_EQ(3, props.DaysBetweenFrames());
    EXPECT_EQ(30, props.MinutesBetweenFrames());
    expectFrames({{2026, 6, 21, 14, 30},
                  {2026, 6, 24, 14, 30},
                  {2026, 6, 27, 14, 30},
                  {2026, 6, 30, 14, 30}},
                 12.5, 51.5, -0.12);
}

TEST_F(SunDialog, AnEndTimeBeforeTheStartTimeLeavesOutTheSeasonsLastDay) {
    season.end = "2026 6 30 14 29 59";
    ASSERT_EQ(CQuarnCommand::success, seasonInDialog(season));
    EXPECT_EQ(3, record().FrameCount());
}

TEST_F(SunDialog, WhatItEditsBesidesIsNotTaken) {
    inBoth([](Entered& entered) { entered.frames = 77; },
           [this] {
               EXPECT_EQ(4, record().FrameCount());
               EXPECT_EQ(L"jpg", record().FileExtension().View());
               EXPECT_EQ(L"Top", record().ViewportName().View()) << "the first of its list";
           });
}

TEST_F(SunDialog, ChosenDisplayModeTypeAndViewportAreTaken) {
    record().SetRenderFull(true);
    record().SetRenderPreview(true);
    inBoth(
        [](Entered& entered) {
            entered.file_type = 2;
            entered.method = 2;
            entered.viewport = 1;
        },
        [this] {
            EXPECT_EQ(L"png", record().FileExtension().View());
            EXPECT_EQ(L"RenderedViewport", record().CaptureMethod().View());
            EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(), record().DisplayMode());
            EXPECT_FALSE(record().RenderFull());
            EXPECT_FALSE(record().RenderPreview());
            EXPECT_EQ(L"Front", record().ViewportName().View());
            record().SetDisplayMode(KM_nil_uuid);
            record().SetRenderFull(true);
            record().SetRenderPreview(true);
        });
}

TEST_F(SunDialog, BothRenderMethodsRenderFullAndKeepTheMode) {
    const KM_UUID mode = CQuarnDisplayAttrsMgr::WireframeModeId();
    for (const int method : {0, 1}) {
        record().SetDisplayMode(mode);
        record().SetRenderFull(false);
        record().SetRenderPreview(true);
        inBoth([method](Entered& entered) { entered.method = method; },
               [&] {
                   EXPECT_EQ(method == 0 ? L"RenderFull" : L"RenderPreview",
                             record().CaptureMethod().View());
                   EXPECT_TRUE(record().RenderFull());
                   EXPECT_FALSE(record().RenderPreview());
                   EXPECT_EQ(mode, record().DisplayMode());
                   record().SetRenderFull(false);
                   record().SetRenderPreview(true);
               });
    }
}

TEST_F(SunDialog, SelectionsOutsideTheirListsChangeNothing) {
    const KM_UUID mode = CQuarnDisplayAttrsMgr::WireframeModeId();
    for (const int selection : {-1, -2000000000, 4, 1000, 2147483647}) {
        const auto prepare = [&] {
            record().SetFileExtension(L"bmp");
            record().SetCaptureMethod(L"Shaded");
            record().SetViewportName(L"Top");
            record().SetDisplayMode(mode);
        };
        prepare();
        inBoth(
            [selection](Entered& entered) {
                entered.file_type = entered.method = entered.viewport = selection;
            },
            [&] {
                EXPECT_EQ(L"bmp", record().FileExtension().View());
                EXPECT_EQ(L"Shaded", record().CaptureMethod().View());
                EXPECT_EQ(L"Top", record().ViewportName().View());
                EXPECT_EQ(mode, record().DisplayMode());
                prepare();
            });
    }
}

TEST_F(SunDialog, EachSelectionIsMeasuredAgainstItsOwnList) {
    ASSERT_EQ(CQuarnCommand::success, run(L"AddView Side Front"));
    const auto choose = [](int file_type, int method, int viewport) {
        return [=](Entered& entered) {
            entered.file_type = file_type;
            entered.method = method;
            entered.viewport = viewport;
        };
    };
    const auto prepare = [this] {
        record().SetFileExtension(L"bmp");
        record().SetCaptureMethod(L"Shaded");
        record().SetViewportName(L"Top");
    };
    // Behind the last file type and the last of the methods that show a sun, but not behind the
    // last of five views.
    prepare();
    inBoth(choose(4, 4, 4), [&] {
        EXPECT_EQ(L"bmp", record().FileExtension().View());
        EXPECT_EQ(L"Shaded", record().CaptureMethod().View());
        EXPECT_EQ(L"Side", record().ViewportName().View());
        prepare();
    });
    inBoth(choose(3, 3, 5), [&] {
        EXPECT_EQ(L"tga", record().FileExtension().View());
        EXPECT_EQ(L"Clay", record().CaptureMethod().View());
        EXPECT_EQ(L"Top", record().ViewportName().View());
        prepare();
    });
}

TEST_F(SunDialog, RenderMethodsThatAreKeptAreKnownInAnyCase) {
    for (const wchar_t* method : {L"renderFULL", L"renderPREVIEW"}) {
        const auto prepare = [this, method] {
            record().SetCaptureMethod(method);
            record().SetRenderFull(false);
            record().SetRenderPreview(true);
        };
        prepare();
        inBoth([](Entered& entered) { entered.method = -1; },
               [&] {
                   EXPECT_TRUE(record().RenderFull());
                   EXPECT_FALSE(record().RenderPreview());
                   EXPECT_EQ(method, record().CaptureMethod().View());
                   prepare();
               });
    }
}

TEST_F(SunDialog, NamesAreTakenAsTheyAre) {
    for (const std::string& name : {std::string("a<b>%s"), std::string(), std::string(300, 'a')}) {
        inBoth([&name](Entered& entered) { entered.name = name; },
               [&] {
                   EXPECT_EQ(name, record().HtmlFilename().ToUtf8());
                   EXPECT_TRUE(front_end.messages().empty());
               });
    }
}

TEST_F(SunDialog, ClosedUnconfirmedLeavesEverythingAsItWas) {
    day.confirmed = season.confirmed = false;
    day.file_type = season.file_type = 2;
    EXPECT_EQ(CQuarnCommand::cancel, dayInDialog(day));
    expectRecordUntouched();
    EXPECT_EQ(CQuarnCommand::cancel, seasonInDialog(season));
    expectRecordUntouched();
}

TEST_F(SunDialog, StepsThatLeadNowhereOrBackGiveOneFrame) {
    for (const int step : {0, -1, -60, -2147483647 - 1}) {
        day.minutes = season.days = step;
        ASSERT_EQ(CQuarnCommand::success, dayInDialog(day));
        EXPECT_THAT(dates(), ElementsAre(L"2026-06-21 06:00:00"));
        EXPECT_EQ(step, record().MinutesBetweenFrames());
        ASSERT_EQ(CQuarnCommand::success, seasonInDialog(season));
        EXPECT_THAT(dates(), ElementsAre(L"2026-06-21 14:30:00"));
        EXPECT_EQ(step, record().DaysBetweenFrames());
    }
}

TEST_F(SunDialog, ADateOrPlaceThatDoesNotExistIsAStudyWithoutFrames) {
    day.start = "2026 4 31 6 0 0";
    ASSERT_EQ(CQuarnCommand::success, dayInDialog(day));
    expectNoFrames(Record::one_day_sun);
    EXPECT_EQ(31, record().StartDay());
    season.end = "2026 6 31 14 30 0";
    ASSERT_EQ(CQuarnCommand::success, seasonInDialog(season));
    expectNoFrames(Record::seasonal_sun);
    EXPECT_EQ(31, record().EndDay());

    day.start = "2026 6 21 6 0 0";
    day.place = "91 0 0";
    ASSERT_EQ(CQuarnCommand::success, dayInDialog(day));
    expectNoFrames(Record::one_day_sun);
    EXPECT_EQ(91.0, record().Latitude());
}

TEST_F(SunCommandsWithoutPlugIn, TellSoAndFail) {
    for (const wchar_t* command : {L"SetOneDaySunAnimation", L"SetSeasonalSunAnimation"}) {
        const std::size_t told = front_end.messages().size();
        EXPECT_EQ(CQuarnCommand::failure, session->runCommand(command, true));
        ASSERT_EQ(told + 1, front_end.messages().size());
        EXPECT_EQ(L"Vex UI (ZEL_VexUI.qnp) cannot be loaded.", front_end.messages().back().text);
        EXPECT_EQ(L"Animation", front_end.messages().back().title);
        EXPECT_EQ(48U, front_end.messages().back().flags);
        expectRecordUntouched();
    }
}

TEST_F(SunCommandsWithoutDialogs, FailWithoutAWord) {
    for (const wchar_t* command : {L"SetOneDaySunAnimation", L"SetSeasonalSunAnimation"}) {
        EXPECT_EQ(CQuarnCommand::failure, session->runCommand(command, true));
        EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
        EXPECT_TRUE(front_end.messages().empty());
        expectRecordUntouched();
    }
}
