#include "tests/zoetrix/fixtures/SunFixture.h"

#include <limits>

using testing::ElementsAre;
using testing::HasSubstr;

namespace {

using Record = KM_3dmAnimationProperties;

class SeasonalSun : public SunFixture {
protected:
    /// Moments at 14:30, so many of them, every so many days from a date.
    static std::vector<Moment> every(int days, Moment first, int count) {
        first.hour = 14;
        first.minute = 30;
        std::vector<Moment> moments;
        for (int k = 0; k < count; ++k)
            moments.push_back(daysAfter(first, k * days));
        return moments;
    }
    const quarn::Question& question(std::size_t index) { return front_end.questions().at(index); }
};

} // namespace

TEST_F(SeasonalSun, EveryWeekFromSpringToWinterIsAFrame) {
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{}));
    // From 21 March to 21 December are 10 + 30 + 31 + 30 + 31 + 31 + 30 + 31 + 30 + 21 = 275 days,
    // which are 39 weeks and two days.
    expectFrames(every(7, {2026, 3, 21}, 40), 0.0, 51.5, 0.12);
    EXPECT_EQ(L"2026-03-21 14:30:00", dates().front());
    EXPECT_EQ(L"2026-03-28 14:30:00", dates()[1]);
    EXPECT_EQ(L"2026-12-19 14:30:00", dates().back());
}

TEST_F(SeasonalSun, TheLastDayIsAFrameWhenAStepFallsOnIt) {
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.days = L"275"}));
    EXPECT_THAT(dates(), ElementsAre(L"2026-03-21 14:30:00", L"2026-12-21 14:30:00"));
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.days = L"276"}));
    EXPECT_THAT(dates(), ElementsAre(L"2026-03-21 14:30:00"));
}

TEST_F(SeasonalSun, GoesOverTheNewYear) {
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.start_day = L"30",
                                                          .start_month = L"12",
                                                          .start_year = L"2025",
                                                          .end_day = L"2",
                                                          .end_month = L"1",
                                                          .days = L"1"}));
    EXPECT_THAT(dates(), ElementsAre(L"2025-12-30 14:30:00", L"2025-12-31 14:30:00",
                                     L"2026-01-01 14:30:00", L"2026-01-02 14:30:00"));
    EXPECT_EQ(2025, record().StartYear());
    EXPECT_EQ(2026, record().EndYear());
}

TEST_F(SeasonalSun, TakesTheLeapDayInLeapYearsOnly) {
    const auto end_of_february = [this](const wchar_t* year) {
        EXPECT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.start_day = L"28",
                                                              .start_month = L"2",
                                                              .start_year = year,
                                                              .end_day = L"1",
                                                              .end_month = L"3",
                                                              .end_year = year,
                                                              .days = L"1"}));
        return dates();
    };
    EXPECT_THAT(
        end_of_february(L"2024"),
        ElementsAre(L"2024-02-28 14:30:00", L"2024-02-29 14:30:00", L"2024-03-01 14:30:00"));
    EXPECT_THAT(end_of_february(L"2000"), testing::SizeIs(3));
    EXPECT_THAT(end_of_february(L"2026"), testing::SizeIs(2));
    EXPECT_THAT(end_of_february(L"1900"), testing::SizeIs(2));
    EXPECT_THAT(end_of_february(L"2100"), testing::SizeIs(2));
}

TEST_F(SeasonalSun, EveryDayOfAYearHasAFrame) {
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.start_day = L"1",
                                                          .start_month = L"1",
                                                          .start_year = L"2024",
                                                          .end_day = L"31",
                                                          .end_year = L"2024",
                                                          .days = L"1"}));
    expectFrames(every(1, {2024, 1, 1}, 366), 0.0, 51.5, 0.12);
}

TEST_F(SeasonalSun, ADecadeOfDaysIsAStudyToo) {
    ASSERT_EQ(CQuarnCommand::success,
              setUp(SeasonAnswers{.start_year = L"2026", .end_year = L"2035", .days = L"1"}));
    // 275 days of the first year, and nine years from 21 December to 21 December with the leap
    // days of 2028 and 2032, both ends counted.
    EXPECT_EQ(275 + 9 * 365 + 2 + 1, record().FrameCount());
    EXPECT_EQ(L"2035-12-21 14:30:00", dates().back());
}

TEST_F(SeasonalSun, WithoutAStepThereIsTheFirstFrameAlone) {
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.days = L"0"}));
    EXPECT_THAT(dates(), ElementsAre(L"2026-03-21 14:30:00"));
    EXPECT_EQ(0, record().DaysBetweenFrames());
    EXPECT_EQ(1, record().FrameCount());
}

TEST_F(SeasonalSun, AStepBeyondTheCalendarLeavesTheFirstFrame) {
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.days = L"2147483647"}));
    EXPECT_THAT(dates(), ElementsAre(L"2026-03-21 14:30:00"));
    EXPECT_EQ(2147483647, record().DaysBetweenFrames());
}

TEST_F(SeasonalSun, AnEndBeforeTheStartStoresAStudyWithoutFrames) {
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.end_day = L"20", .end_month = L"3"}));
    expectNoFrames(Record::seasonal_sun);
    EXPECT_EQ(20, record().EndDay());
    EXPECT_EQ(3, record().EndMonth());
    EXPECT_EQ(2026, record().EndYear());
    EXPECT_EQ(CQuarnCommand::failure, run(L"PlayAnimation"));
    EXPECT_THAT(printed(), HasSubstr(L"No animation is currently set."));
}

TEST_F(SeasonalSun, NightFramesAreKeptBelowTheGround) {
    ASSERT_EQ(CQuarnCommand::success,
              setUp(SeasonAnswers{.hour = L"0", .minute = L"0", .days = L"30"}));
    EXPECT_EQ(10, record().FrameCount());
    for (const KM_3dPoint& sun : record().CameraPoints())
        EXPECT_LT(sun.z, 0.0);
}

TEST_F(SeasonalSun, StoresThePlaceTheDatesTheTimeAndTheStep) {
    record().SetEndHour(19);
    record().SetEndMinutes(17);
    record().SetEndSeconds(41);
    record().SetStartSeconds(11);
    record().SetMinutesBetweenFrames(13);
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.latitude = L"-33.9",
                                                          .longitude = L"289.5",
                                                          .north_angle = L"30",
                                                          .start_day = L"2",
                                                          .start_month = L"11",
                                                          .start_year = L"2024",
                                                          .end_day = L"5",
                                                          .end_month = L"2",
                                                          .end_year = L"2025",
                                                          .hour = L"9",
                                                          .minute = L"45",
                                                          .days = L"10"}));
    const Record& props = record();
    EXPECT_EQ(Record::seasonal_sun, props.CaptureType());
    EXPECT_EQ(0, props.CurrentFrame());
    EXPECT_EQ(-33.9, props.Latitude());
    EXPECT_EQ(289.5, props.Longitude());
    EXPECT_EQ(30.0, props.NorthAngle());
    EXPECT_EQ(2, props.StartDay());
    EXPECT_EQ(11, props.StartMonth());
    EXPECT_EQ(2024, props.StartYear());
    EXPECT_EQ(5, props.EndDay());
    EXPECT_EQ(2, props.EndMonth());
    EXPECT_EQ(2025, props.EndYear());
    EXPECT_EQ(9, props.StartHour());
    EXPECT_EQ(45, props.StartMinutes());
    EXPECT_EQ(0, props.StartSeconds());
    EXPECT_EQ(10, props.DaysBetweenFrames());
    // What belongs to the study of one day stays.
    EXPECT_EQ(19, props.EndHour());
    EXPECT_EQ(17, props.EndMinutes());
    EXPECT_EQ(41, props.EndSeconds());
    EXPECT_EQ(13, props.MinutesBetweenFrames());
    // 28 + 31 + 31 + 5 = 95 days: nine steps.
    EXPECT_EQ(10, props.FrameCount());
}

TEST_F(SeasonalSun, QuestionsHaveTheirTextsOrderAndDefaults) {
    ASSERT_EQ(CQuarnCommand::success,
              askedFor(SeasonAnswers{}, 12, {L"_Enter", L"_Enter", L"_Enter", L"_Enter"}));
    const struct {
        const wchar_t* prompt;
        const wchar_t* default_answer;
        quarn::Question::Kind kind;
    } expected[] = {
        {L"Latitude of animation location", L"40", quarn::Question::Kind::number},
        {L"Longitude of animation location", L"10", quarn::Question::Kind::number},
        {L"North angle (clockwise from Y axis)", L"5", quarn::Question::Kind::number},
        {L"Start day", L"1", quarn::Question::Kind::integer},
        {L"Start month", L"6", quarn::Question::Kind::integer},
        {L"Start year", L"2010", quarn::Question::Kind::integer},
        {L"End day", L"3", quarn::Question::Kind::integer},
        {L"End month", L"4", quarn::Question::Kind::integer},
        {L"End year", L"2015", quarn::Question::Kind::integer},
        {L"Hour of the day for animation (0-23)", L"6", quarn::Question::Kind::integer},
        {L"Minute of the day (0-59)", L"0", quarn::Question::Kind::integer},
        {L"Days between frames", L"30", quarn::Question::Kind::integer},
    };
    ASSERT_EQ(std::size(expected) + 4, front_end.questions().size());
    for (std::size_t k = 0; k < std::size(expected); ++k) {
        EXPECT_EQ(expected[k].prompt, question(k).prompt.View());
        EXPECT_EQ(expected[k].default_answer, question(k).default_answer->View()) << k;
        EXPECT_EQ(expected[k].kind, question(k).kind) << k;
        EXPECT_FALSE(question(k).accepts_nothing) << k;
    }
    EXPECT_EQ(L"File type", question(12).prompt.View());
    // The two renderers and the modes that show the sun, Rendered and Clay.
    EXPECT_EQ(4U, question(13).options.size());
    EXPECT_EQ(L"RenderedViewport", question(13).options[2].english_name.View());
    EXPECT_EQ(L"Animation sequence name", question(15).prompt.View());
}

TEST_F(SeasonalSun, LimitsAreTakenAndWhatLiesBeyondIsRefused) {
    const struct {
        std::wstring SeasonAnswers::*answer;
        std::initializer_list<const wchar_t*> taken;
        std::initializer_list<const wchar_t*> refused;
    } questions[] = {
        {&SeasonAnswers::latitude, {L"-90", L"90"}, {L"-90.001", L"90.001"}},
        {&SeasonAnswers::longitude, {L"0", L"180.5", L"360"}, {L"-0.001", L"360.001", L"-105"}},
        {&SeasonAnswers::north_angle, {L"-360", L"360"}, {L"-360.001", L"360.001"}},
        {&SeasonAnswers::start_day, {L"1", L"31"}, {L"0", L"32", L"-1"}},
        {&SeasonAnswers::start_month, {L"1", L"12"}, {L"0", L"13", L"-3"}},
        {&SeasonAnswers::start_year, {L"2026", L"0"}, {L"2027", L"20.5"}},
        {&SeasonAnswers::end_day, {L"1", L"31"}, {L"0", L"32", L"-1"}},
        {&SeasonAnswers::end_month, {L"1", L"12"}, {L"0", L"13", L"-3"}},
        {&SeasonAnswers::end_year, {L"2026", L"2100"}, {L"2025", L"2101", L"-2026"}},
        {&SeasonAnswers::hour, {L"0", L"23"}, {L"-1", L"24"}},
        {&SeasonAnswers::minute, {L"0", L"59"}, {L"-1", L"60"}},
        {&SeasonAnswers::days, {L"0", L"1", L"100000"}, {L"-1", L"-7"}},
    };
    for (const auto& question : questions) {
        for (const wchar_t* text : question.refused) {
            SeasonAnswers answers;
            answers.*question.answer = text;
            EXPECT_EQ(CQuarnCommand::failure, setUp(answers)) << KM_wString(text).ToUtf8();
            expectRecordUntouched();
        }
    }
    for (const auto& question : questions) {
        for (const wchar_t* text : question.taken) {
            SeasonAnswers answers;
            answers.*question.answer = text;
            EXPECT_EQ(CQuarnCommand::success, setUp(answers)) << KM_wString(text).ToUtf8();
        }
    }
}

TEST_F(SeasonalSun, AStartYearIsTakenWithoutItsSign) {
    ASSERT_EQ(CQuarnCommand::success,
              setUp(SeasonAnswers{.start_year = L"-2020", .end_year = L"2020", .days = L"300"}));
    EXPECT_EQ(2020, record().StartYear());
    EXPECT_THAT(dates(), ElementsAre(L"2020-03-21 14:30:00"));
    // The end year is measured against the year without the sign.
    SunFixture::SetUp();
    EXPECT_EQ(CQuarnCommand::failure,
              setUp(SeasonAnswers{.start_year = L"-2020", .end_year = L"2019"}));
    expectRecordUntouched();
}

TEST_F(SeasonalSun, TheLeastStartYearThatCanBeTypedIsSurvived) {
    // No end year lies between it and 2100.
    EXPECT_EQ(CQuarnCommand::failure, setUp(SeasonAnswers{.start_year = L"-2147483648"}));
    expectRecordUntouched();
}

TEST_F(SeasonalSun, ALongitudeThatTheStudyOfOneDayStoredCannotBeTakenOverByEnter) {
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.longitude = L"-105"}));
    EXPECT_EQ(-105.0, record().Longitude());
    front_end.clearPrinted();
    EXPECT_EQ(CQuarnCommand::failure, setUp(SeasonAnswers{.longitude = L"_Enter"}));
    EXPECT_THAT(printed(), HasSubstr(L"Enter a number from 0 to 360"));
    EXPECT_EQ(Record::one_day_sun, record().CaptureType());
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.longitude = L"255"}));
    EXPECT_EQ(255.0, record().Longitude());
}

TEST_F(SeasonalSun, EveryQuestionCancelledFailsAndLeavesTheRecord) {
    for (std::size_t given = 0; given < 12; ++given) {
        const std::size_t before = front_end.questions().size();
        EXPECT_EQ(CQuarnCommand::failure, askedFor(SeasonAnswers{}, given, {L"_Cancel"}));
        EXPECT_EQ(before + given + 1, front_end.questions().size());
        EXPECT_EQ(L"", printed()) << given;
        expectRecordUntouched();
    }
}

TEST_F(SeasonalSun, QuestionsForOutputEndTheCommandWithTheirOwnResults) {
    const KM_wString line = L"SetSeasonalSunAnimation 51.5 0.12 0 21 3 2026 21 12 2026 14 30 7 ";
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

TEST_F(SeasonalSun, ADateThatDoesNotExistIsAStudyWithoutFramesThatKeepsItsNumbers) {
    ASSERT_EQ(CQuarnCommand::success,
              setUp(SeasonAnswers{.start_day = L"31", .start_month = L"4"}));
    expectNoFrames(Record::seasonal_sun);
    EXPECT_EQ(31, record().StartDay());
    EXPECT_EQ(4, record().StartMonth());
    EXPECT_EQ(14, record().StartHour());
    EXPECT_EQ(30, record().StartMinutes());

    ASSERT_EQ(CQuarnCommand::success,
              setUp(SeasonAnswers{.end_day = L"29", .end_month = L"2", .end_year = L"2027"}));
    expectNoFrames(Record::seasonal_sun);
    EXPECT_EQ(29, record().EndDay());
    EXPECT_EQ(2, record().EndMonth());
    EXPECT_EQ(2027, record().EndYear());
}

TEST_F(SeasonalSun, YearsInWhichTheSunHasNoPositionMakeNoFrames) {
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.start_day = L"30",
                                                          .start_month = L"12",
                                                          .start_year = L"1799",
                                                          .end_day = L"2",
                                                          .end_month = L"1",
                                                          .end_year = L"1800",
                                                          .days = L"1"}));
    // The frames begin with the first date that has a sun, and run on without a gap.
    EXPECT_THAT(dates(), ElementsAre(L"1800-01-01 14:30:00", L"1800-01-02 14:30:00"));
    EXPECT_EQ(2, record().FrameCount());
    EXPECT_EQ(1799, record().StartYear());
}
