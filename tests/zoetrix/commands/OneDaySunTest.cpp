#include "tests/zoetrix/fixtures/SunFixture.h"

#include <limits>

using testing::ElementsAre;
using testing::HasSubstr;

namespace {

using Record = KM_3dmAnimationProperties;

class OneDaySun : public SunFixture {
protected:
    /// Moments of 21 June 2026, every so many minutes from one minute of the day to another.
    static std::vector<Moment> midsummer(int from, int to, int step) {
        std::vector<Moment> moments;
        for (int minute = from; minute <= to; minute += step)
            moments.push_back({2026, 6, 21, minute / 60, minute % 60});
        return moments;
    }
    const quarn::Question& question(std::size_t index) { return front_end.questions().at(index); }
};

} // namespace

TEST_F(OneDaySun, FromSixToEighteenEveryHourIsThirteenFrames) {
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{}));
    EXPECT_EQ(13, record().FrameCount());
    expectFrames(midsummer(6 * 60, 18 * 60, 60), 0.0, 51.5, -0.12);
    EXPECT_EQ(L"2026-06-21 06:00:00", dates().front());
    EXPECT_EQ(L"2026-06-21 18:00:00", dates().back());
}

TEST_F(OneDaySun, EverySevenMinutesLosesNoFrameOfTheDay) {
    ASSERT_EQ(CQuarnCommand::success,
              setUp(DayAnswers{
                  .start_hour = L"0", .end_hour = L"23", .end_minute = L"59", .minutes = L"7"}));
    // 1439 = 205 * 7 + 4, so 206 frames, the last at minute 1435.
    EXPECT_EQ(206, record().FrameCount());
    expectFrames(midsummer(0, 1439, 7), 0.0, 51.5, -0.12);
    EXPECT_EQ(L"2026-06-21 23:55:00", dates().back());
}

TEST_F(OneDaySun, EveryMinuteOfTheDayHasAFrame) {
    ASSERT_EQ(CQuarnCommand::success,
              setUp(DayAnswers{
                  .start_hour = L"0", .end_hour = L"23", .end_minute = L"59", .minutes = L"1"}));
    EXPECT_EQ(1440, record().FrameCount());
    EXPECT_EQ(L"2026-06-21 14:30:00", dates()[14 * 60 + 30]);
    EXPECT_EQ(L"2026-06-21 23:59:00", dates().back());
}

TEST_F(OneDaySun, AYearThatTheSunIsNotKnownInIsToldOnce) {
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.year = L"1750"}));
    expectNoFrames(Record::one_day_sun);
    EXPECT_EQ(L"SetOneDaySunAnimation: The sun has no position in the year 1750: it is known for "
              L"the years 1800 to 2199\n",
              printed());
    front_end.clearPrinted();
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{}));
    EXPECT_EQ(L"", printed()) << "nothing of the command before";
}

TEST_F(OneDaySun, ATimeThatTheStepsPassOverEndsTheStudyBefore) {
    ASSERT_EQ(CQuarnCommand::success,
              setUp(DayAnswers{.end_hour = L"7", .end_minute = L"59", .minutes = L"30"}));
    EXPECT_THAT(dates(), ElementsAre(L"2026-06-21 06:00:00", L"2026-06-21 06:30:00",
                                     L"2026-06-21 07:00:00", L"2026-06-21 07:30:00"));
}

TEST_F(OneDaySun, AWholeDayAsAStepIsOneFrame) {
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.minutes = L"1440"}));
    EXPECT_THAT(dates(), ElementsAre(L"2026-06-21 06:00:00"));
}

TEST_F(OneDaySun, WithoutAStepThereIsTheFirstFrameAlone) {
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.minutes = L"0"}));
    EXPECT_THAT(dates(), ElementsAre(L"2026-06-21 06:00:00"));
    EXPECT_EQ(1, record().FrameCount());
    EXPECT_EQ(0, record().MinutesBetweenFrames());
    EXPECT_EQ(CQuarnCommand::success, run(L"PlayAnimation"));
}

TEST_F(OneDaySun, TheStartItselfIsAFrameWhenItIsAlsoTheEnd) {
    ASSERT_EQ(CQuarnCommand::success,
              setUp(DayAnswers{.start_hour = L"12", .end_hour = L"12", .end_minute = L"0"}));
    EXPECT_THAT(dates(), ElementsAre(L"2026-06-21 12:00:00"));
}

TEST_F(OneDaySun, AnEndBeforeTheStartStoresAStudyWithoutFrames) {
    for (const wchar_t* step : {L"60", L"0"}) {
        record() = Record();
        ASSERT_EQ(CQuarnCommand::success,
                  setUp(DayAnswers{.start_hour = L"18", .end_hour = L"6", .minutes = step}));
        expectNoFrames(Record::one_day_sun);
        EXPECT_EQ(18, record().StartHour());
        EXPECT_EQ(6, record().EndHour());
        EXPECT_EQ(21, record().StartDay());
        EXPECT_EQ(CQuarnCommand::failure, run(L"PlayAnimation"));
        EXPECT_THAT(printed(), HasSubstr(L"No animation is currently set."));
    }
}

TEST_F(OneDaySun, NightFramesAreKeptBelowTheGround) {
    ASSERT_EQ(CQuarnCommand::success,
              setUp(DayAnswers{.start_hour = L"0", .end_hour = L"23", .minutes = L"60"}));
    expectFrames(midsummer(0, 23 * 60, 60), 0.0, 51.5, -0.12);
    // In London the sun of this day rises at 03:43 and sets at 20:21 universal time (The
    // Astronomical Almanac, sunrise and sunset tables).
    for (int hour = 0; hour < 24; ++hour)
        EXPECT_EQ(hour >= 4 && hour <= 20, record().CameraPoints()[hour].z > 0.0) << hour;
}

TEST_F(OneDaySun, StoresThePlaceTheDayTheTimesAndTheStep) {
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.latitude = L"-33.9",
                                                       .longitude = L"151.2",
                                                       .north_angle = L"-359.5",
                                                       .start_hour = L"7",
                                                       .start_minute = L"5",
                                                       .end_hour = L"17",
                                                       .end_minute = L"55",
                                                       .minutes = L"25"}));
    const Record& props = record();
    EXPECT_EQ(Record::one_day_sun, props.CaptureType());
    EXPECT_EQ(0, props.CurrentFrame());
    EXPECT_EQ(-33.9, props.Latitude());
    EXPECT_EQ(151.2, props.Longitude());
    EXPECT_EQ(-359.5, props.NorthAngle());
    EXPECT_EQ(21, props.StartDay());
    EXPECT_EQ(6, props.StartMonth());
    EXPECT_EQ(2026, props.StartYear());
    EXPECT_EQ(7, props.StartHour());
    EXPECT_EQ(5, props.StartMinutes());
    EXPECT_EQ(0, props.StartSeconds());
    EXPECT_EQ(17, props.EndHour());
    EXPECT_EQ(55, props.EndMinutes());
    EXPECT_EQ(0, props.EndSeconds());
    EXPECT_EQ(25, props.MinutesBetweenFrames());
    // 07:05 to 17:55 are 650 minutes: 26 steps.
    expectFrames(midsummer(425, 1075, 25), -359.5, -33.9, 151.2);
}

TEST_F(OneDaySun, LeavesTheLastDateAndTheDaysOfASeasonAlone) {
    record().SetDaysBetweenFrames(11);
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{}));
    EXPECT_EQ(3, record().EndDay());
    EXPECT_EQ(4, record().EndMonth());
    EXPECT_EQ(2015, record().EndYear());
    EXPECT_EQ(11, record().DaysBetweenFrames());
}

TEST_F(OneDaySun, FramesOfTheStudyBeforeAreGone) {
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{}));
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.end_hour = L"7"}));
    expectFrames(midsummer(6 * 60, 7 * 60, 60), 0.0, 51.5, -0.12);
}

TEST_F(OneDaySun, QuestionsHaveTheirTextsOrderAndDefaults) {
    ASSERT_EQ(CQuarnCommand::success,
              askedFor(DayAnswers{}, 11, {L"_Enter", L"_Enter", L"_Enter", L"_Enter"}));
    const struct {
        const wchar_t* prompt;
        const wchar_t* default_answer;
        quarn::Question::Kind kind;
    } expected[] = {
        {L"Latitude of animation location(-90 to 90)", L"40", quarn::Question::Kind::number},
        {L"Longitude of animation location(-180 to 180)", L"10", quarn::Question::Kind::number},
        {L"North angle (clockwise from Y axis)", L"5", quarn::Question::Kind::number},
        {L"Day of animation", L"1", quarn::Question::Kind::integer},
        {L"Month of animation", L"6", quarn::Question::Kind::integer},
        {L"Year of animation", L"2010", quarn::Question::Kind::integer},
        {L"Start hour for animation (0-23)", L"6", quarn::Question::Kind::integer},
        {L"Start minute (0-59)", L"0", quarn::Question::Kind::integer},
        {L"End hour for animation (0-23)", L"18", quarn::Question::Kind::integer},
        {L"End minute (0-59)", L"0", quarn::Question::Kind::integer},
        {L"Minutes between frames", L"30", quarn::Question::Kind::integer},
    };
    ASSERT_EQ(std::size(expected) + 4, front_end.questions().size());
    for (std::size_t k = 0; k < std::size(expected); ++k) {
        EXPECT_EQ(expected[k].prompt, question(k).prompt.View());
        EXPECT_EQ(expected[k].default_answer, question(k).default_answer->View()) << k;
        EXPECT_EQ(expected[k].kind, question(k).kind) << k;
        EXPECT_FALSE(question(k).accepts_nothing) << k;
    }
    EXPECT_EQ(L"File type", question(11).prompt.View());
    EXPECT_EQ(L"Frame capture method", question(12).prompt.View());
    EXPECT_EQ(L"Viewport name to render", question(13).prompt.View());
    EXPECT_EQ(L"Animation sequence name", question(14).prompt.View());
}

TEST_F(OneDaySun, AnswersAreTheDefaultsOfTheNextRun) {
    ASSERT_EQ(CQuarnCommand::success,
              setUp(DayAnswers{.day = L"2", .month = L"3", .year = L"1999", .end_hour = L"9"}));
    const std::vector<std::wstring> before = dates();
    record().Dates().Empty();
    const std::wstring enter = L"_Enter";
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{enter, enter, enter, enter, enter, enter,
                                                       enter, enter, enter, enter, enter}));
    EXPECT_EQ(before, dates());
    EXPECT_EQ(L"1999-03-02 09:00:00", dates().back());
}

TEST_F(OneDaySun, LimitsAreTakenAndWhatLiesBeyondIsRefused) {
    const struct {
        std::wstring DayAnswers::*answer;
        std::initializer_list<const wchar_t*> taken;
        std::initializer_list<const wchar_t*> refused;
    } questions[] = {
        {&DayAnswers::latitude, {L"-90", L"90", L"0"}, {L"-90.001", L"90.001"}},
        {&DayAnswers::longitude, {L"-180", L"180"}, {L"-180.001", L"180.001", L"359"}},
        {&DayAnswers::north_angle, {L"-360", L"360"}, {L"-360.001", L"360.001"}},
        {&DayAnswers::day, {L"1", L"30"}, {L"0", L"32", L"-1"}},
        {&DayAnswers::month, {L"1", L"12"}, {L"0", L"13"}},
        {&DayAnswers::year, {L"1800", L"2199", L"-2026", L"0", L"2147483647"}, {L"20.5"}},
        {&DayAnswers::start_hour, {L"0", L"23"}, {L"-1", L"24"}},
        {&DayAnswers::start_minute, {L"0", L"59"}, {L"-1", L"60"}},
        {&DayAnswers::end_hour, {L"0", L"23"}, {L"-1", L"24"}},
        {&DayAnswers::end_minute, {L"0", L"59"}, {L"-1", L"60"}},
        {&DayAnswers::minutes, {L"0", L"1", L"1440"}, {L"-1", L"1441"}},
    };
    for (const auto& question : questions) {
        for (const wchar_t* text : question.refused) {
            DayAnswers answers;
            answers.*question.answer = text;
            EXPECT_EQ(CQuarnCommand::failure, setUp(answers)) << KM_wString(text).ToUtf8();
            expectRecordUntouched();
        }
    }
    for (const auto& question : questions) {
        for (const wchar_t* text : question.taken) {
            DayAnswers answers;
            answers.*question.answer = text;
            EXPECT_EQ(CQuarnCommand::success, setUp(answers)) << KM_wString(text).ToUtf8();
        }
    }
}

TEST_F(OneDaySun, EveryQuestionCancelledFailsAndLeavesTheRecord) {
    for (std::size_t given = 0; given < 11; ++given) {
        const std::size_t before = front_end.questions().size();
        EXPECT_EQ(CQuarnCommand::failure, askedFor(DayAnswers{}, given, {L"_Cancel"}));
        EXPECT_EQ(before + given + 1, front_end.questions().size());
        EXPECT_EQ(L"", printed()) << given;
        expectRecordUntouched();
    }
}

TEST_F(OneDaySun, QuestionsForOutputEndTheCommandWithTheirOwnResults) {
    const KM_wString line = L"SetOneDaySunAnimation 51.5 -0.12 0 21 6 2026 6 0 18 0 60 ";
    for (const wchar_t* rest :
         {L"_Cancel", L"png _Cancel", L"png _Enter _Cancel", L"png _Enter Top _Cancel"}) {
        EXPECT_EQ(CQuarnCommand::cancel, run(line + rest)) << KM_wString(rest).ToUtf8();
        expectRecordUntouched();
    }
    for (const wchar_t* rest : {L"png _Nonsense", L"png _Enter Nowhere"}) {
        EXPECT_EQ(CQuarnCommand::failure, run(line + rest)) << KM_wString(rest).ToUtf8();
        expectRecordUntouched();
    }
}

TEST_F(OneDaySun, OnlyModesThatShowTheSunAreOffered) {
    ASSERT_EQ(CQuarnCommand::success,
              askedFor(DayAnswers{}, 11, {L"png", L"_RenderedViewport", L"Top", L"Walk"}));
    std::vector<std::wstring> names;
    for (const quarn::QuestionOption& option : question(12).options)
        names.emplace_back(option.english_name.View());
    EXPECT_THAT(names, ElementsAre(L"RenderFull", L"RenderPreview", L"RenderedViewport", L"Clay"));
    EXPECT_EQ(L"png", record().FileExtension().View());
    EXPECT_EQ(L"RenderedViewport", record().CaptureMethod().View());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(), record().DisplayMode());
    EXPECT_EQ(L"Top", record().ViewportName().View());
    EXPECT_EQ(L"Sun", record().HtmlFilename().View()) << "the answer is not stored";
}

TEST_F(OneDaySun, DefaultsOutsideTheLimitsAreRefusedLikeAnswers) {
    // A study of a season stores longitudes up to 360; its place cannot be taken over by Enter.
    record().SetLongitude(255.0);
    EXPECT_EQ(CQuarnCommand::failure, setUp(DayAnswers{.longitude = L"_Enter"}));
    EXPECT_EQ(CQuarnCommand::success, setUp(DayAnswers{.longitude = L"-105"}));
    record().SetMinutesBetweenFrames(-60);
    EXPECT_EQ(CQuarnCommand::failure, setUp(DayAnswers{.minutes = L"_Enter"}));
    record().SetStartDay(77);
    EXPECT_EQ(CQuarnCommand::failure, setUp(DayAnswers{.day = L"_Enter"}));
}

TEST_F(OneDaySun, ADayThatTheMonthDoesNotHaveIsAStudyWithoutFramesThatKeepsItsNumbers) {
    const struct {
        const wchar_t* day;
        const wchar_t* month;
        const wchar_t* year;
    } days[] = {{L"31", L"4", L"2026"}, {L"29", L"2", L"2026"}, {L"30", L"2", L"2024"},
                {L"1", L"1", L"0"},     {L"1", L"1", L"-2026"}, {L"1", L"1", L"10000"}};
    for (const auto& day : days) {
        ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.day = day.day,
                                                           .month = day.month,
                                                           .year = day.year,
                                                           .start_minute = L"5",
                                                           .end_minute = L"7"}));
        expectNoFrames(Record::one_day_sun);
        EXPECT_EQ(std::stoi(day.day), record().StartDay());
        EXPECT_EQ(std::stoi(day.month), record().StartMonth());
        EXPECT_EQ(std::stoi(day.year), record().StartYear());
        EXPECT_EQ(6, record().StartHour());
        EXPECT_EQ(5, record().StartMinutes());
        EXPECT_EQ(18, record().EndHour());
        EXPECT_EQ(7, record().EndMinutes());
        EXPECT_EQ(0, record().EndSeconds());
        EXPECT_EQ(60, record().MinutesBetweenFrames());
    }
}

TEST_F(OneDaySun, TheLeapDayIsADay) {
    ASSERT_EQ(CQuarnCommand::success,
              setUp(DayAnswers{.day = L"29", .month = L"2", .year = L"2024", .end_hour = L"6"}));
    EXPECT_THAT(dates(), ElementsAre(L"2024-02-29 06:00:00"));
}

TEST_F(OneDaySun, YearsInWhichTheSunHasNoPositionMakeNoFrames) {
    for (const wchar_t* year : {L"1799", L"2200", L"1", L"9999"}) {
        ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.year = year}));
        expectNoFrames(Record::one_day_sun);
    }
    for (const wchar_t* year : {L"1800", L"2199"}) {
        ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.year = year}));
        EXPECT_EQ(13, record().FrameCount());
    }
}

TEST_F(OneDaySun, SecondsOfTheRecordDoNotMoveTheTimes) {
    record().SetStartSeconds(30);
    record().SetEndSeconds(59);
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{}));
    EXPECT_EQ(L"2026-06-21 06:00:00", dates().front());
    EXPECT_EQ(0, record().StartSeconds());
    EXPECT_EQ(0, record().EndSeconds());
}
