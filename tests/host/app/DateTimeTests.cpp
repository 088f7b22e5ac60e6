#include "sdk/qncore/QnDateTime.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>

namespace {

constexpr int LARGEST = std::numeric_limits<int>::max();
constexpr int SMALLEST = std::numeric_limits<int>::min();

std::wstring textOf(const COleDateTime& time) {
    return time.Format(0, 52).Array();
}

int stepsWithin(COleDateTime time, const COleDateTime& end, const COleDateTimeSpan& span) {
    int steps = 0;
    for (; time <= end; time += span)
        ++steps;
    return steps;
}

TEST(DateTime, IsWrittenFromTheYearDownToTheSecond) {
    EXPECT_EQ(textOf({2026, 6, 21, 14, 30, 0}), L"2026-06-21 14:30:00");
    EXPECT_EQ(textOf({1, 2, 3, 4, 5, 6}), L"0001-02-03 04:05:06");
    EXPECT_EQ(textOf({9999, 12, 31, 23, 59, 59}), L"9999-12-31 23:59:59");
}

TEST(DateTime, FlagsAndLocaleDoNotChangeTheText) {
    const COleDateTime time(2026, 6, 21, 14, 30, 0);
    EXPECT_EQ(std::wstring(time.Format().Array()), L"2026-06-21 14:30:00");
    EXPECT_EQ(std::wstring(time.Format(4, 1031).Array()), L"2026-06-21 14:30:00");
}

TEST(DateTime, BothEndsOfAnHourlyDayCount) {
    EXPECT_EQ(stepsWithin({2026, 6, 21, 6, 0, 0}, {2026, 6, 21, 18, 0, 0}, {0, 0, 60, 0}), 13);
}

// 1439 minutes from 00:00 to 23:59: 1439 / 7 = 205.57, and the first one.
TEST(DateTime, StepsOfSevenMinutesOverADayLoseNoneToRounding) {
    EXPECT_EQ(stepsWithin({2026, 6, 21, 0, 0, 0}, {2026, 6, 21, 23, 59, 0}, {0, 0, 7, 0}), 206);
}

TEST(DateTime, EveryStepThatDividesTheDayMeetsTheNextMidnightExactly) {
    const COleDateTime start(2024, 2, 28, 0, 0, 0);
    for (int minutes = 1; minutes <= 1440; ++minutes) {
        if (1440 % minutes != 0)
            continue;
        COleDateTime time = start;
        for (int step = 0; step < 1440 / minutes; ++step)
            time += COleDateTimeSpan(0, 0, minutes, 0);
        EXPECT_EQ(textOf(time), L"2024-02-29 00:00:00") << minutes;
    }
}

TEST(DateTime, EndBeforeStartHasNoSteps) {
    EXPECT_EQ(stepsWithin({2026, 6, 21, 18, 0, 0}, {2026, 6, 21, 6, 0, 0}, {0, 1, 0, 0}), 0);
}

// 30 December of a leap year is 364 days, 52 weeks, after 1 January.
TEST(DateTime, DaysFollowTheCalendar) {
    COleDateTimeSpan week;
    week.SetDateTimeSpan(7, 0, 0, 0);
    EXPECT_EQ(stepsWithin({2024, 1, 1, 12, 0, 0}, {2024, 12, 30, 12, 0, 0}, week), 52 + 1);
    COleDateTime time(2023, 2, 28, 12, 0, 0);
    time += COleDateTimeSpan(1, 0, 0, 0);
    EXPECT_EQ(textOf(time), L"2023-03-01 12:00:00");
    time += COleDateTimeSpan(366, 0, 0, 0);
    EXPECT_EQ(textOf(time), L"2024-03-01 12:00:00");
    time += COleDateTimeSpan(-1, 0, 0, -1);
    EXPECT_EQ(textOf(time), L"2024-02-29 11:59:59");
}

TEST(DateTime, NumbersAreReadBackAfterASpan) {
    COleDateTime time(1999, 12, 31, 23, 59, 58);
    time += COleDateTimeSpan(0, 0, 0, 4);
    EXPECT_EQ(time.GetYear(), 2000);
    EXPECT_EQ(time.GetMonth(), 1);
    EXPECT_EQ(time.GetDay(), 1);
    EXPECT_EQ(time.GetHour(), 0);
    EXPECT_EQ(time.GetMinute(), 0);
    EXPECT_EQ(time.GetSecond(), 2);
}

TEST(DateTime, TheEarlierIsTheLesser) {
    const COleDateTime noon(2026, 6, 21, 12, 0, 0);
    EXPECT_LT(noon, COleDateTime(2026, 6, 21, 12, 0, 1));
    EXPECT_LT(COleDateTime(2025, 12, 31, 23, 59, 59), noon);
    EXPECT_EQ(noon, COleDateTime(2026, 6, 21, 12, 0, 0));
    EXPECT_FALSE(noon < COleDateTime(2026, 6, 21, 12, 0, 0));
}

TEST(DateTime, ADateAloneIsItsMidnight) {
    COleDateTime time(2026, 6, 21, 12, 34, 56);
    EXPECT_TRUE(time.SetDate(2024, 2, 29));
    EXPECT_EQ(textOf(time), L"2024-02-29 00:00:00");
}

TEST(DateTime, NumbersOfNoCalendarOrClockAreKeptButHaveNoPlaceInTime) {
    const COleDateTime impossible(2026, 4, 31, 12, 0, 0);
    EXPECT_FALSE(impossible.IsValid());
    EXPECT_EQ(impossible.GetDay(), 31);
    EXPECT_EQ(textOf(impossible), L"");
    const COleDateTime real(2026, 4, 30, 12, 0, 0);
    EXPECT_FALSE(impossible <= real);
    EXPECT_FALSE(real <= impossible);
    EXPECT_FALSE(impossible == impossible);
    COleDateTime moved = impossible;
    moved += COleDateTimeSpan(1, 0, 0, 0);
    EXPECT_FALSE(moved.IsValid());
    EXPECT_EQ(moved.GetDay(), 31);
}

TEST(DateTime, SettersSayWhatIsImpossible) {
    COleDateTime time;
    EXPECT_FALSE(time.IsValid());
    EXPECT_TRUE(time.SetDate(2000, 2, 29));
    EXPECT_FALSE(time.SetDate(1900, 2, 29));
    EXPECT_FALSE(time.SetDate(0, 1, 1));
    EXPECT_FALSE(time.SetDate(10000, 1, 1));
    EXPECT_FALSE(time.SetDate(2026, 257, 1));
    EXPECT_FALSE(time.SetDate(SMALLEST, LARGEST, SMALLEST));
    EXPECT_FALSE(time.SetDateTime(2026, 6, 21, 24, 0, 0));
    EXPECT_FALSE(time.SetDateTime(2026, 6, 21, 0, 60, 0));
    EXPECT_FALSE(time.SetDateTime(2026, 6, 21, 0, 0, 60));
    EXPECT_FALSE(time.SetDateTime(2026, 6, 21, -1, 0, 0));
    EXPECT_TRUE(time.SetDateTime(2026, 6, 21, 23, 59, 59));
}

TEST(DateTime, LeavingTheLastYearOrTheFirstEndsEveryComparison) {
    COleDateTime time(9999, 12, 31, 23, 59, 59);
    time += COleDateTimeSpan(0, 0, 0, 1);
    EXPECT_FALSE(time.IsValid());
    EXPECT_EQ(time.GetYear(), 0);
    COleDateTime first(1, 1, 1, 0, 0, 0);
    first += COleDateTimeSpan(0, 0, 0, -1);
    EXPECT_FALSE(first.IsValid());
    EXPECT_EQ(stepsWithin({2026, 1, 1, 0, 0, 0}, {9999, 12, 31, 0, 0, 0}, {LARGEST, 0, 0, 0}), 1);
}

// 2147483647 * (86400 + 3600 + 60 + 1)
TEST(DateTimeSpan, HoldsTheLargestNumbers) {
    EXPECT_EQ(COleDateTimeSpan(LARGEST, LARGEST, LARGEST, LARGEST).GetTotalSeconds(),
              2147483647LL * 90061);
    EXPECT_EQ(COleDateTimeSpan(1, -24, 0, 0), COleDateTimeSpan());
    EXPECT_LT(COleDateTimeSpan(0, 0, -1, 0), COleDateTimeSpan());
}

} // namespace
