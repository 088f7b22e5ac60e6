#include "host/almanac/CourseChoice.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

using namespace std::chrono;

CivilSite siteOf(const std::string& place) {
    const City* const city = findCity(place);
    CivilSite site{nameWithCountry(*city), city->latitude_deg, city->longitude_deg};
    EXPECT_TRUE(giveZone(site, "").ok());
    return site;
}

WantedTime clock(minutes time) {
    return {WantedTime::Since::midnight, time};
}

TEST(CivilSites, HaveTheClocksOfTheirCityOrOfTheNearestWhichIsTold) {
    EXPECT_EQ(siteOf("Kolkata").zone.name(), "Asia/Kolkata");
    CivilSite potsdam{"", 52.4, 13.1};
    const auto nearest = giveZone(potsdam, "");
    ASSERT_TRUE(nearest.ok());
    ASSERT_TRUE(nearest.value());
    EXPECT_EQ(nameWithCountry(*nearest.value()), "Berlin, Germany");
    EXPECT_EQ(potsdam.zone.name(), "Europe/Berlin");
    const auto asked = giveZone(potsdam, "+05:30");
    ASSERT_TRUE(asked.ok());
    EXPECT_FALSE(asked.value());
    EXPECT_FALSE(giveZone(potsdam, "Europe/Nowhere").ok());
}

TEST(StudyCourses, DayOnTwoDatesOfTheStudiesClockHasTwoSpans) {
    // 174.76 E are 11 whole hours; summer time there is 13 hours ahead.
    const auto course =
        courseOfDay(siteOf("Auckland"), {2026y / December / 21, clock(80min), clock(20h)}, 60);
    ASSERT_TRUE(course.ok()) << course.message();
    EXPECT_EQ(frameCount(course.value()), 19);
    const auto spans = studySpans(course.value());
    ASSERT_EQ(spans.size(), 2U);
    EXPECT_EQ(spans[0].first, local_days(2026y / December / 20) + 23h + 20min);
    EXPECT_EQ(spans[1].first, local_days(2026y / December / 21) + 20min);
    EXPECT_EQ(spans[1].last, local_days(2026y / December / 21) + 18h);
}

TEST(StudyCourses, SeasonIsAYearAtTheStandardTimeOfThePlace) {
    const auto course = courseOfSeason(siteOf("Athens"), 2024y / February / 29, {}, 12h, 7);
    ASSERT_TRUE(course.ok()) << course.message();
    EXPECT_EQ(course.value().start, sys_days(2024y / February / 29) + 10h);
    EXPECT_EQ(course.value().end, sys_days(2025y / February / 27) + 10h);
    EXPECT_EQ(frameCount(course.value()), 53);
}

TEST(StudyCourses, ThatCannotBeSaySo) {
    const auto mistakeOf = [](const Result<StudyCourse>& course) {
        return course.ok() ? "" : course.message();
    };
    EXPECT_NE(
        mistakeOf(courseOfDay(siteOf("Athens"), {2026y / June / 21, clock(12h), clock(11h)}, 15))
            .find("is before"),
        std::string::npos);
    EXPECT_NE(
        mistakeOf(courseOfSeason(siteOf("Athens"), 2026y / June / 21, 2026y / June / 20, 12h, 1))
            .find("is before"),
        std::string::npos);
    // 254 degrees east are 16 hours: the last day of 2100 is a day of 2101 there.
    CivilSite west{"", 39.74, -105.18};
    ASSERT_TRUE(giveZone(west, "").ok());
    EXPECT_NE(mistakeOf(courseOfSeason(west, 2100y / December / 1, 2100y / December / 31, 12h, 1))
                  .find("beyond the years 1800 to 2100"),
              std::string::npos);
}

} // namespace
} // namespace quarn
