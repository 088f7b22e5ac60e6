#include "tests/quarn/ProgramRun.h"
#include "tests/support/TempFolder.h"

#include <chrono>
#include <cmath>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <numbers>

namespace quarn::test {
namespace {

using testing::AllOf;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;

using Words = std::vector<std::string>;

Words joined(Words first, const Words& second) {
    first.insert(first.end(), second.begin(), second.end());
    return first;
}

Ended day(const Words& options, const std::string& model = "town.obj") {
    return run(joined({"day", model, "--out", "out", "--show-script"}, options));
}

Ended dayInAthens(const Words& options, const std::string& model = "town.obj") {
    return day(joined({"--place", "Athens", "--date", "2026-06-21"}, options), model);
}

Ended season(const Words& options) {
    return run(joined({"season", "town.obj", "--out", "out", "--show-script"}, options));
}

/// At 105.18 degrees west, from spring to winter of 2026.
Ended seasonInTheWest(const Words& options) {
    return season(joined({"--latitude", "39.74", "--longitude", "-105.18", "--from", "2026-03-21",
                          "--to", "2026-12-21"},
                         options));
}

Words scriptOf(const Ended& ended) {
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.err, IsEmpty());
    return linesOf(ended.out);
}

void expectRefusal(const Ended& ended, const Words& words) {
    EXPECT_EQ(ended.exit_code, 2);
    EXPECT_THAT(ended.out, IsEmpty());
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, StartsWith("quarn: "));
    for (const std::string& word : words)
        EXPECT_THAT(ended.err, HasSubstr(word));
}

/// From where a composed script lets the camera look at its target.
struct CameraDirection {
    double azimuth_deg = NAN; ///< clockwise from the Y axis
    double elevation_deg = NAN;
};

CameraDirection cameraDirection(const Words& script) {
    constexpr double DEGREES = 180.0 / std::numbers::pi;
    for (const std::string& line : script) {
        double e[3];
        double t[3];
        if (std::sscanf(line.c_str(), "_-Camera _Location %lf,%lf,%lf _Target %lf,%lf,%lf _Enter",
                        &e[0], &e[1], &e[2], &t[0], &t[1], &t[2]) != 6)
            continue;
        const double x = e[0] - t[0];
        const double y = e[1] - t[1];
        return {std::atan2(x, y) * DEGREES, std::atan2(e[2] - t[2], std::hypot(x, y)) * DEGREES};
    }
    return {};
}

// ---- The scripts

// On that day the sun's upper edge rises at 6:02 and sets at 20:51 in Athens, and its centre
// without refraction some five minutes later and earlier.
TEST(DayScript, SetsUpTheDefaultsOfAPlace) {
    const Words script = scriptOf(dayInAthens({}));
    ASSERT_THAT(script, SizeIs(14));
    EXPECT_THAT(Words(script.begin(), script.begin() + 4),
                ElementsAre("# Athens, Greece: 37.98 N, 23.73 E",
                            "# Clock: Europe/Athens, EEST (UTC+3)",
                            "# First frame: 2026-06-21 06:15 EEST = 03:15 UTC",
                            "# The recording's own page tells times by UTC+1, the whole hours of "
                            "the longitude"));
    EXPECT_EQ(script[4], "_-Import \"town.obj\"");
    EXPECT_EQ(script[5], "_-ViewportSize 1280 720");
    EXPECT_THAT(script[6], StartsWith("_-Camera _Location "));
    EXPECT_EQ(script[7], "_-FitView _Distance 1.1 _Enter");
    EXPECT_EQ(script[8], "_-AnimationName \"town\"");
    EXPECT_EQ(script[9], "_-SetOneDaySunAnimation 37.98 23.73 0 21 6 2026 4 15 18 45 15 _jpg "
                         "_RenderedViewport _Enter _Enter");
    EXPECT_EQ(script[10], "_-SunStudyPlace \"Athens, Greece\" \"Europe/Athens\"");
    EXPECT_EQ(script[13], "_-RecordAnimation _TargetFolder \"out\" _Enter");
}

TEST(DayScript, HoldsEveryOption) {
    const Words script = scriptOf(
        day({"--latitude", "-33.5",      "--longitude", "-70.25", "--north",     "-12.5",
             "--date",     "2199-02-28", "--from",      "4:05",   "--to",        "21:50",
             "--every",    "7",          "--azimuth",   "0",      "--elevation", "0",
             "--distance", "2",          "--target",    "1,2,3",  "--mode",      "render preview",
             "--size",     "640x360",    "--format",    "png",    "--hide",      "Trees",
             "--up",       "y",          "--name",      "Sun",    "--save",      "sun"}));
    // Summer time of Santiago is UTC-3, the whole hours of 70.25 W are UTC-4.
    EXPECT_THAT(script, Contains("_-SetOneDaySunAnimation -33.5 -70.25 -12.5 28 2 2199 3 5 20 50 7 "
                                 "_png _RenderPreview _Enter _Enter"));
    EXPECT_THAT(script, Contains("_-FitView _KeepTarget=Yes _Distance 2 _Enter"));
    EXPECT_THAT(script, Contains("_-SaveAs \"sun.quarn\""));
    EXPECT_THAT(script, Contains("_-Hide \"Trees\""));
    // Behind the model at the height of the target
    EXPECT_NEAR(cameraDirection(script).azimuth_deg, 0.0, 1e-9);
    EXPECT_NEAR(cameraDirection(script).elevation_deg, 0.0, 1e-9);
}

TEST(SeasonScript, PassesWesternLongitudesPlus360) {
    // 15:30 on UTC-7 is 14:30 of the next day on UTC+16.
    EXPECT_THAT(scriptOf(seasonInTheWest({"--north", "30", "--every", "14", "--at", "15:30"})),
                Contains("_-SetSeasonalSunAnimation 39.74 254.82 30 22 3 2026 22 12 2026 14 30 14 "
                         "_jpg _RenderedViewport _Enter _Enter"));
    EXPECT_THAT(
        scriptOf(season({"--place", "Athens", "--from", "2026-03-21", "--to", "2100-12-31"})),
        Contains("_-SetSeasonalSunAnimation 37.98 23.73 0 21 3 2026 31 12 2100 11 0 7 _jpg "
                 "_RenderedViewport _Enter _Enter"));
    // The ends of the range
    const Words ends = {"--latitude", "0", "--from", "2026-01-01", "--to", "2026-01-01"};
    EXPECT_THAT(scriptOf(season(joined(ends, {"--longitude", "-180"}))),
                Contains(StartsWith("_-SetSeasonalSunAnimation 0 180 0 ")));
    EXPECT_THAT(scriptOf(season(joined(ends, {"--longitude", "-0.000000001"}))),
                Contains(StartsWith("_-SetSeasonalSunAnimation 0 359.999999999 0 ")));
    EXPECT_THAT(scriptOf(season(joined(ends, {"--longitude", "0"}))),
                Contains(StartsWith("_-SetSeasonalSunAnimation 0 0 0 ")));
}

// ---- The clock

TEST(SunStudyClock, IsTheOneOnTheWallOfThePlace) {
    const auto at = [](const char* place, const char* date) {
        return scriptOf(day({"--place", place, "--date", date, "--from", "06:00", "--to", "7:00"}));
    };
    const Words summer = at("Berlin", "2026-06-21");
    EXPECT_THAT(summer, Contains("# Clock: Europe/Berlin, CEST (UTC+2)"));
    EXPECT_THAT(summer, Contains("# First frame: 2026-06-21 06:00 CEST = 04:00 UTC"));
    EXPECT_THAT(summer, Contains(HasSubstr(" 21 6 2026 4 0 5 0 15 ")));
    EXPECT_THAT(at("Berlin", "2026-12-21"), Contains(HasSubstr(" 21 12 2026 5 0 6 0 15 ")));
    // 5:30 ahead of UTC, on the whole hours of 88.36 E, which are 5
    const Words half = at("Kolkata", "2026-06-21");
    EXPECT_THAT(half, Contains("# Clock: Asia/Kolkata, IST (UTC+5:30)"));
    EXPECT_THAT(half, Contains(HasSubstr(" 21 6 2026 5 30 6 30 15 ")));
    // The rule of 2040 is that of the last years that are listed.
    EXPECT_THAT(at("Sydney", "2040-12-21"),
                Contains("# First frame: 2040-12-21 06:00 AEDT = 2040-12-20 19:00 UTC"));
}

TEST(SunStudyClock, OfCoordinatesIsThatOfTheNearestCity) {
    const Words script =
        scriptOf(day({"--latitude", "52.4", "--longitude", "13.1", "--date", "2026-06-21"}));
    EXPECT_THAT(script, Contains("# Clock: Europe/Berlin, CEST (UTC+2)"));
    EXPECT_THAT(script, Contains("# The clock is that of Berlin, Germany, the nearest city known; "
                                 "--zone takes another"));
    EXPECT_THAT(script, Contains("_-SunStudyPlace \"52.4 N, 13.1 E\" \"Europe/Berlin\""));
}

TEST(SunStudyClock, CanBeAskedFor) {
    const auto by = [](const char* zone) {
        return dayInAthens({"--zone", zone, "--from", "06:00"});
    };
    EXPECT_THAT(scriptOf(by("UTC")), Contains("# First frame: 2026-06-21 06:00 UTC = 06:00 UTC"));
    EXPECT_THAT(scriptOf(by("+05:30")),
                Contains("# First frame: 2026-06-21 06:00 UTC+5:30 = 00:30 UTC"));
    // 23.73 degrees are 94.92 minutes: 4:25:05 UTC, told and taken to the minute
    EXPECT_THAT(scriptOf(by("solar")), Contains("# First frame: 2026-06-21 06:00 LMT = 04:25 UTC"));
    EXPECT_THAT(scriptOf(by("solar")), Contains(HasSubstr(" 21 6 2026 5 25 ")));
    expectRefusal(by("Europe/Atens"), {"--zone", "Did you mean Europe/Athens?"});
    expectRefusal(by("+25:00"), {"\"+25:00\" is no time zone"});
}

TEST(SunStudyClock, HourThatClocksSkipIsRefused) {
    const auto on = [](const char* from, const char* to) {
        return day({"--place", "Berlin", "--date", "2026-03-29", "--from", from, "--to", to});
    };
    expectRefusal(on("02:30", "12:00"),
                  {"--from 02:30 on 2026-03-29 does not exist in Europe/Berlin: clocks go until "
                   "02:00 CET, when they are put forward to 03:00 CEST."});
    expectRefusal(on("00:00", "02:00"), {"--to 02:00 on 2026-03-29 does not exist"});
    const Words script = scriptOf(on("01:30", "04:00"));
    EXPECT_THAT(script, Contains("# Clocks are put forward to 03:00 CEST, one minute after 01:59 "
                                 "CET"));
    EXPECT_THAT(script, Contains(HasSubstr(" 29 3 2026 0 30 2 0 15 ")));
    expectRefusal(day({"--latitude", "-13.8", "--longitude", "-171.8", "--date", "2011-12-30"}),
                  {"2011-12-30 does not exist in Pacific/Apia"});
}

TEST(SunStudyClock, OfAnHourThatComesTwiceTheWholeIsTaken) {
    const Words script = scriptOf(day({"--place", "Berlin", "--date", "2026-10-25", "--from",
                                       "02:30", "--to", "02:45", "--every", "5"}));
    EXPECT_THAT(script, Contains("# First frame: 2026-10-25 02:30 CEST = 00:30 UTC"));
    EXPECT_THAT(script, Contains("# 02:30 on 2026-10-25 comes twice: --from takes the first, 02:30 "
                                 "CEST"));
    EXPECT_THAT(script, Contains("# 02:45 on 2026-10-25 comes twice: --to takes the second, 02:45 "
                                 "CET"));
    EXPECT_THAT(script, Contains(HasSubstr(" 25 10 2026 0 30 1 45 5 ")));
}

/// 174.76 E are 11 whole hours, and summer time there is UTC+13.
TEST(SunStudyClock, DayOnTwoDatesOfTheStudiesClockIsSetUpAsTwo) {
    const Words script = scriptOf(day({"--place", "Auckland", "--date", "2026-12-21", "--from",
                                       "01:20", "--to", "20:00", "--every", "60"}));
    const auto first = std::ranges::find_if(script, [](const std::string& line) {
        return line.starts_with("_-SetOneDaySunAnimation");
    });
    ASSERT_GE(script.end() - first, 5);
    EXPECT_THAT(*first, HasSubstr(" 20 12 2026 23 20 23 59 60 "));
    EXPECT_EQ(first[1], "_-JoinSunStudy _Keep");
    EXPECT_THAT(first[2], HasSubstr(" 21 12 2026 0 20 18 0 60 "));
    EXPECT_EQ(first[3], "_-JoinSunStudy _Append");
    EXPECT_THAT(first[4], StartsWith("_-SunStudyPlace "));
}

/// 254.82 degrees east are 16 whole hours: noon on UTC-7 is 11:00 of the next day there.
TEST(SunStudyClock, OfASeasonInTheWestShowsTheDatesOfThePlace) {
    const Words script = scriptOf(seasonInTheWest({}));
    EXPECT_THAT(script, Contains("# 39.74 N, 105.18 W"));
    EXPECT_THAT(script, Contains("# Clock: America/Denver, MDT (UTC-6)"));
    EXPECT_THAT(script, Contains("# First frame: 2026-03-21 13:00 MDT = 19:00 UTC"));
    EXPECT_THAT(script, Contains("# Every frame is at 12:00 of UTC-7, which is 13:00 MDT while "
                                 "clocks are put forward"));
    EXPECT_THAT(script, Contains("# The recording's own page tells times by UTC+16, the whole "
                                 "hours of the longitude"));
    EXPECT_THAT(script, Contains(HasSubstr(" 22 3 2026 22 12 2026 11 0 7 ")));
}

TEST(SunStudyClock, OfASeasonKeepsStandardTimeInBothHemispheres) {
    const Words script = scriptOf(season(
        {"--place", "Sydney", "--from", "2026-01-01", "--to", "2026-02-01", "--at", "9:30"}));
    EXPECT_THAT(script, Contains("# First frame: 2026-01-01 10:30 AEDT = 2025-12-31 23:30 UTC"));
    EXPECT_THAT(script, Contains(HasSubstr(" 1 1 2026 1 2 2026 9 30 7 ")));
    EXPECT_THAT(scriptOf(season({"--place", "Kolkata", "--from", "2026-01-01"})),
                Contains(HasSubstr(" 1 1 2026 31 12 2026 11 30 7 ")));
}

// ---- What is taken where nothing is said

// Rise and set at 60 N 0 E on 21 June 2019: 02:36 and 21:28, United States Naval Observatory.
TEST(SunStudyDefaults, TimesMayBeThoseOfTheSun) {
    const auto script =
        scriptOf(day({"--latitude", "60", "--longitude", "0", "--zone", "UTC", "--date",
                      "2019-06-21", "--from", "sunrise+1h", "--to", "sunset-1h30m"}));
    EXPECT_THAT(script, Contains(testing::ContainsRegex("First frame: 2019-06-21 03:3[567] UTC")));
    EXPECT_THAT(script, Contains(testing::ContainsRegex(" 21 6 2019 3 3[567] 19 5[789] 15 ")));
}

TEST(SunStudyDefaults, DaysMayBeThoseOfTheYearsCourse) {
    const auto on = [](const char* date) {
        return scriptOf(day({"--place", "Athens", "--date", date}));
    };
    const auto frame = [](const char* days) {
        return Contains(testing::ContainsRegex("First frame: [0-9]{4}-" + std::string(days)));
    };
    EXPECT_THAT(on("equinox-march"), frame("03-(19|20|21)"));
    EXPECT_THAT(on("solstice-june"), frame("06-(20|21|22)"));
    EXPECT_THAT(on("equinox-september"), frame("09-(22|23|24)"));
    EXPECT_THAT(on("solstice-december"), frame("12-(20|21|22|23)"));
    EXPECT_THAT(on("solstice-june-2030"), Contains(HasSubstr("First frame: 2030-06-21 ")));
    EXPECT_THAT(scriptOf(season({"--place", "Athens", "--from", "solstice-june-2030"})),
                Contains("# First frame: 2030-06-21 13:00 EEST = 10:00 UTC"));
}

TEST(SunStudyDefaults, DayIsToday) {
    using namespace std::chrono;
    const auto today = [] { return year_month_day{floor<days>(system_clock::now() + hours(10))}; };
    const auto before = today();
    const Words script =
        scriptOf(day({"--latitude", "0", "--longitude", "150", "--zone", "+10:00"}));
    const auto after = today(); // midnight may have come between
    const auto dateOf = [](const year_month_day& date) {
        return testing::HasSubstr(" " + std::to_string(unsigned(date.day())) + " " +
                                  std::to_string(unsigned(date.month())) + " " +
                                  std::to_string(int(date.year())) + " ");
    };
    EXPECT_THAT(script, Contains(testing::AnyOf(dateOf(before), dateOf(after))));
}

TEST(SunStudyDefaults, SeasonIsAYearAtNoon) {
    const auto lineOf = [](const Words& dates) {
        const Words script = scriptOf(season(joined({"--place", "Accra"}, dates)));
        const auto line = std::ranges::find_if(
            script, [](const std::string& text) { return text.starts_with("_-SetSeasonal"); });
        return line == script.end() ? std::string() : *line;
    };
    // 0.2 W counts as 359.8 E, on UTC+23: 12:00 is 11:00 of the next day.
    EXPECT_THAT(lineOf({"--from", "2024-02-29"}), HasSubstr(" 1 3 2024 28 2 2025 11 0 7 "));
    EXPECT_THAT(lineOf({"--to", "2026-06-30"}), HasSubstr(" 2 7 2025 1 7 2026 11 0 7 "));
    EXPECT_THAT(lineOf({}), testing::ContainsRegex(" 2 1 [0-9]+ 1 1 [0-9]+ 11 0 7 "));
}

TEST(SunStudyDefaults, PolarNightIsRefusedAndPolarDayTold) {
    const auto in = [](const char* date) { return day({"--place", "Tromsø", "--date", date}); };
    expectRefusal(in("2026-12-21"), {"the sun does not rise there on 2026-12-21; give --from"});
    const Words summer = scriptOf(in("2026-06-21"));
    EXPECT_THAT(summer, Contains("# The sun does not set there on 2026-06-21"));
    EXPECT_THAT(summer, Contains("# First frame: 2026-06-21 00:00 CEST = 2026-06-20 22:00 UTC"));
    expectRefusal(
        day({"--place", "Tromsø", "--date", "2026-12-21", "--from", "sunrise", "--to", "12:00"}),
        {"--from: the sun does not rise there on 2026-12-21"});
    EXPECT_EQ(day({"--place", "Tromsø", "--date", "2026-12-21", "--from", "09:00", "--to", "15:00"})
                  .exit_code,
              0);
}

// The sun of Athens is highest at 13:27 of summer time on that day.
TEST(SunStudyDefaults, StepLongerThanTheDayIsLightShowsTheHighestSun) {
    EXPECT_THAT(scriptOf(dayInAthens({"--every", "1440"})),
                Contains("# First frame: 2026-06-21 13:27 EEST = 10:27 UTC"));
}

TEST(SunStudyDefaults, TimesOfTheSunAreOneOffset) {
    for (const char* time : {"sunrise+", "sunrise+1", "sunrise1h", "sunset-30", "sunset-30m1h",
                             "sunset--5m", "sunrise+12h", "sunrise+-1h", "Sunrise", "sunset+1h5"})
        expectRefusal(dayInAthens({"--from", time}), {"--from must be a time from 00:00", time});
    expectRefusal(dayInAthens({"--from", "sunset", "--to", "sunrise"}), {"is before --from"});
}

// ---- The camera

TEST(SunStudyView, LooksFromTheFrontAndTheRightAtAModelFile) {
    const CameraDirection direction = cameraDirection(scriptOf(dayInAthens({})));
    EXPECT_NEAR(direction.azimuth_deg, 150.0, 1e-9);
    EXPECT_NEAR(direction.elevation_deg, 30.0, 1e-9);
    const CameraDirection chosen =
        cameraDirection(scriptOf(dayInAthens({"--azimuth", "-90", "--elevation", "60"})));
    EXPECT_NEAR(chosen.azimuth_deg, -90.0, 1e-9);
    EXPECT_NEAR(chosen.elevation_deg, 60.0, 1e-9);
}

TEST(SunStudyView, OfADocumentStaysUnlessAnOptionMovesIt) {
    const auto script = [](const Words& options) {
        return scriptOf(dayInAthens(options, "town.quarn"));
    };
    EXPECT_THAT(script({}), Not(Contains(AllOf(HasSubstr("View"), Not(HasSubstr("Viewport"))))));
    EXPECT_TRUE(std::isnan(cameraDirection(script({})).azimuth_deg));
    EXPECT_THAT(script({"--distance", "2"}), Contains("_-FitView _Distance 2 _Enter"));
    EXPECT_TRUE(std::isnan(cameraDirection(script({"--distance", "2"})).azimuth_deg));
    EXPECT_NEAR(cameraDirection(script({"--elevation", "50"})).elevation_deg, 50.0, 1e-9);
}

TEST(SunStudyView, CanBeAStandardOneOrACameraOfTheModel) {
    const Words plan = scriptOf(dayInAthens({"--view", "top"}));
    EXPECT_THAT(plan, Contains("_-StandardView \"top\""));
    EXPECT_THAT(plan, Contains("_-FitView _Distance 1.1 _Enter"));
    const Words camera = scriptOf(dayInAthens({"--view", "Camera 1"}));
    EXPECT_THAT(camera, Contains("_-StandardView \"Camera 1\""));
    EXPECT_THAT(camera, Not(Contains(StartsWith("_-FitView"))));
    EXPECT_THAT(scriptOf(dayInAthens({"--view", "Camera 1", "--distance", "1.5"})),
                Contains("_-FitView _Distance 1.5 _Enter"));
}

// ---- Refusals

TEST(SunStudySite, MustBeGivenOnceAndWhole) {
    const Words date = {"--date", "2026-06-21"};
    expectRefusal(day(date), {"--place", "--latitude", "--longitude", "quarn places"});
    expectRefusal(day(joined(date, {"--latitude", "5"})), {"--latitude and --longitude"});
    expectRefusal(day(joined(date, {"--longitude", "5"})), {"--latitude and --longitude"});
    expectRefusal(dayInAthens({"--latitude", "5", "--longitude", "5"}), {"either --place"});
    expectRefusal(dayInAthens({"--longitude", "5"}), {"either --place"});
}

TEST(SunStudySite, UnknownPlacesGetSuggestions) {
    const auto at = [](const char* place) {
        return day({"--date", "2026-06-21", "--place", place});
    };
    expectRefusal(at("Lodnon"),
                  {"--place", "Lodnon", "Is it one of these: London, United Kingdom?"});
    expectRefusal(at("Birmingham"),
                  {"Birmingham, United Kingdom; Birmingham, United States. Give the country"});
    expectRefusal(at("Xyzzyxyzzy"), {"Xyzzyxyzzy", "quarn places"});
    expectRefusal(at(""), {"--place"});
    EXPECT_THAT(scriptOf(at("birmingham, usa")),
                Contains(StartsWith("# Birmingham, United States: ")));
}

TEST(SunStudySite, NumbersOutOfRangeAreRefused) {
    const auto at = [](const char* latitude, const char* longitude) {
        return day({"--date", "2026-06-21", "--latitude", latitude, "--longitude", longitude,
                    "--from", "06:00", "--to", "07:00"});
    };
    for (const char* latitude : {"90.5", "-90.001", "north", "nan", ""})
        expectRefusal(at(latitude, "0"),
                      {"--latitude must be a number of degrees from -90 to 90", latitude});
    for (const char* longitude : {"180.5", "-181", "254.82", "5E", "inf"})
        expectRefusal(at("0", longitude),
                      {"--longitude must be a number of degrees from -180 to 180", longitude});
    for (const char* north : {"361", "-360.5", "N"})
        expectRefusal(dayInAthens({"--north", north}),
                      {"--north must be a number of degrees from -360 to 360", north});
    EXPECT_EQ(at("90", "180").exit_code, 0);
    EXPECT_EQ(at("-90", "-180").exit_code, 0);
}

TEST(SunStudyDates, AreIsoDatesOfTheCalendar) {
    const auto on = [](const std::string& date) {
        return day({"--place", "Athens", "--date", date});
    };
    for (const char* date : {"21.6.2026", "2026-6-21", "06/21/2026", "20260621", "2026-06-2x", "",
                             "+026-06-21", "2026-06-021", "tomorrow"})
        expectRefusal(on(date), {"--date must be a date such as 2026-06-21", date});
    for (const char* date : {"2026-04-31", "2026-02-29", "2100-02-29", "2026-13-01", "2026-00-10",
                             "2026-01-00", "0000-01-01"})
        expectRefusal(on(date), {"--date must be a day of the calendar", date});
    for (const char* date : {"1799-12-31", "2200-01-01"})
        expectRefusal(on(date), {"--date must be in the years 1800 to 2199", date});
    for (const char* date : {"1800-01-01", "2199-12-31", "2000-02-29"})
        EXPECT_EQ(on(date).exit_code, 0) << date;
}

TEST(SunStudyDates, OfASeasonNameTheirOption) {
    const auto between = [](const char* from, const char* to) {
        return season({"--place", "Athens", "--from", from, "--to", to});
    };
    expectRefusal(between("2026-04-31", "2026-05-01"), {"--from must be a day", "2026-04-31"});
    expectRefusal(between("2026-04-01", "2026-06-31"), {"--to must be a day", "2026-06-31"});
    expectRefusal(between("1799-04-01", "2026-06-30"),
                  {"--from must be in the years 1800 to 2100"});
    expectRefusal(between("2100-04-01", "2101-01-01"), {"--to must be in the years 1800 to 2100"});
    expectRefusal(between("2026-04-02", "2026-04-01"),
                  {"--to 2026-04-01 is before --from 2026-04-02"});
    EXPECT_EQ(between("2026-04-02", "2026-04-02").exit_code, 0);
}

TEST(SunStudyTimes, AreOfAClockAndRunForward) {
    for (const char* time :
         {"25:00", "24:00", "12:60", "6", "6:5", "006:05", "06:05:00", "-1:00", "noon", ""}) {
        expectRefusal(dayInAthens({"--from", time}), {"--from must be a time from 00:00", time});
        expectRefusal(dayInAthens({"--to", time}), {"--to must be a time from 00:00", time});
        expectRefusal(seasonInTheWest({"--at", time}), {"--at must be a time from 00:00", time});
    }
    expectRefusal(dayInAthens({"--from", "12:00", "--to", "11:59"}),
                  {"--to 11:59 EEST is before --from 12:00 EEST"});
    EXPECT_EQ(dayInAthens({"--from", "00:00", "--to", "23:59"}).exit_code, 0);
    EXPECT_EQ(dayInAthens({"--from", "12:00", "--to", "12:00"}).exit_code, 0);
}

TEST(SunStudySteps, AreWholeAndNeverNone) {
    for (const char* step : {"0", "-15", "1441", "7.5", "often"})
        expectRefusal(dayInAthens({"--every", step}),
                      {"--every must be a whole number of minutes from 1 to 1440", step});
    for (const char* step : {"0", "-7", "0.5", "99999999999"})
        expectRefusal(seasonInTheWest({"--every", step}),
                      {"--every must be a whole number of days from 1", step});
    EXPECT_EQ(dayInAthens({"--every", "1440"}).exit_code, 0);
    EXPECT_EQ(seasonInTheWest({"--every", "2147483647"}).exit_code, 0);
}

TEST(SunStudyMode, IsTheOneThatStudiesAreDrawnInOrARenderMethod) {
    for (const char* mode : {"Wireframe", "Shaded", "Translucent", "X-Ray", "Drawing", "Clay"})
        expectRefusal(dayInAthens({"--mode", mode}),
                      {"sun studies are not recorded in", mode,
                       "--mode takes Rendered, RenderFull, RenderPreview."});
    expectRefusal(dayInAthens({"--mode", "Cubist"}), {"unknown display mode", "Cubist"});
    for (const char* mode : {"Rendered", "RenderFull", "render preview"})
        EXPECT_EQ(dayInAthens({"--mode", mode}).exit_code, 0) << mode;
}

TEST(SunStudyView, OptionsThatAreNoneAreRefused) {
    expectRefusal(dayInAthens({"--azimuth", "south"}), {"--azimuth must be a number", "south"});
    for (const char* elevation : {"-1", "90", "high"})
        expectRefusal(dayInAthens({"--elevation", elevation}),
                      {"--elevation must be a number of degrees from 0 to 89", elevation});
    expectRefusal(dayInAthens({"--distance", "0"}), {"--distance must be a number from 0.01"});
    expectRefusal(dayInAthens({"--target", "1,2"}), {"--target must be three numbers"});
    expectRefusal(dayInAthens({"--view", "Top", "--azimuth", "30"}), {"--view", "--azimuth"});
    expectRefusal(dayInAthens({"--view", "a\"b"}), {"--view"});
}

// ---- Help and places

TEST(SunStudyHelp, ExplainsNorthClocksAndDaylightSaving) {
    const Ended one_day = run({"day", "--help"});
    const Ended seasonal = run({"season", "--help"});
    for (const Ended* const help : {&one_day, &seasonal}) {
        EXPECT_EQ(help->exit_code, 0);
        for (const char* word :
             {"--place", "--latitude", "--longitude", "--north", "--every", "--azimuth", "--view",
              "--mode", "--hide", "--save", "--show-script", "clockwise from the Y axis",
              "clocks on the wall there", "daylight saving", "Seconds are always 0", "--zone",
              "Examples:"})
            EXPECT_THAT(help->out, HasSubstr(word));
        EXPECT_THAT(help->out, Not(HasSubstr("Wireframe")));
    }
    EXPECT_THAT(one_day.out, HasSubstr("--date"));
    EXPECT_THAT(seasonal.out, HasSubstr("UTC+16"));
}

TEST(Places, AreListedWithCoordinatesAndZones) {
    const Ended all = run({"places"});
    ASSERT_EQ(all.exit_code, 0) << all.err;
    EXPECT_GT(linesOf(all.out).size(), 300u);
    const Ended some = run({"places", "GREECE"});
    ASSERT_EQ(some.exit_code, 0) << some.err;
    EXPECT_THAT(linesOf(some.out),
                ElementsAre("place         country  latitude  longitude  time zone",
                            "Athens        Greece    37.98 N   23.73 E   Europe/Athens",
                            "Thessaloniki  Greece    40.64 N   22.94 E   Europe/Athens"));
    EXPECT_THAT(run({"places", "Denver"}).out, HasSubstr("104.99 W   America/Denver\n"));
}

TEST(Places, AreFoundByWhatTheyMayBeCalled) {
    EXPECT_THAT(run({"places", "sao paulo"}).out, HasSubstr("São Paulo"));
    EXPECT_THAT(run({"places", "Lodnon"}).out, HasSubstr("London"));
    EXPECT_THAT(run({"places", "München"}).out, HasSubstr("Munich"));
    EXPECT_THAT(run({"places", "uk"}).out, HasSubstr("Birmingham"));
    const Ended none = run({"places", "Xyzzyxyzzy"});
    EXPECT_EQ(none.exit_code, 1);
    EXPECT_THAT(none.err, HasSubstr("Xyzzyxyzzy"));
    expectRefusal(run({"places", "new", "york"}), {"unexpected argument york"});
}

// ---- A place that the model states

/// An IFC file that states a place, with north along its X axis.
std::string sitedModel(const TempFolder& folder, const char* latitude = "(47,30,0)") {
    writeFile(folder / "site.ifc",
              "ISO-10303-21;\nDATA;\n"
              "#4= IFCGEOMETRICREPRESENTATIONCONTEXT($,'Model',3,1.E-05,#6,#7);\n"
              "#7= IFCDIRECTION((1.,0.,0.));\n"
              "#8= IFCSITE('a',#1,'b',$,$,#9,$,$,.ELEMENT.," +
                  std::string(latitude) + ",(8,15,0),430.,$,$);\nENDSEC;\n");
    return (folder / "site.ifc").string();
}

TEST(StatedPlace, CountsWhereNoOptionGivesOne) {
    const TempFolder folder;
    const Words script = scriptOf(day({"--date", "2026-06-21"}, sitedModel(folder)));
    EXPECT_THAT(script, Contains("# As site.ifc states: 47.5 N, 8.25 E"));
    EXPECT_THAT(script, Contains(StartsWith("_-SetOneDaySunAnimation 47.5 8.25 90 ")));
}

TEST(StatedPlace, GivesWayToOptionsEachOnItsOwn) {
    const TempFolder folder;
    EXPECT_THAT(scriptOf(dayInAthens({}, sitedModel(folder))),
                Contains(StartsWith("_-SetOneDaySunAnimation 37.98 23.73 0 ")));
    EXPECT_THAT(scriptOf(day({"--date", "2026-06-21", "--north", "0"}, sitedModel(folder))),
                Contains(StartsWith("_-SetOneDaySunAnimation 47.5 8.25 0 ")));
}

TEST(StatedPlace, IsAskedForWhereTheModelStatesNone) {
    const TempFolder folder;
    expectRefusal(day({"--date", "2026-06-21"}, sitedModel(folder, "$")), {"--place"});
}

TEST(SunStudyScript, LensIsChosenBeforeTheViewIsFitted) {
    const Words lines = scriptOf(dayInAthens({"--lens", "35"}));
    EXPECT_THAT(lines, Contains(AllOf(StartsWith("_-Camera _Location"),
                                      testing::EndsWith(" _Parallel=No _Lens 35 _Enter"))));
    const Words named = scriptOf(dayInAthens({"--lens", "35", "--view", "perspective"}));
    const auto lens = std::ranges::find(named, "_-Camera _Parallel=No _Lens 35 _Enter");
    ASSERT_NE(lens, named.end());
    EXPECT_EQ(*(lens - 1), "_-StandardView \"perspective\"");
    EXPECT_THAT(*(lens + 1), StartsWith("_-FitView"));
    const Words own = scriptOf(dayInAthens({"--lens", "35"}, "town.quarn"));
    const auto of_document = std::ranges::find(own, "_-Camera _Parallel=No _Lens 35 _Enter");
    ASSERT_NE(of_document, own.end());
    EXPECT_THAT(*(of_document + 1), StartsWith("_-FitView"));
}

TEST(SunStudyScript, ParallelViewsHaveNoLens) {
    for (const char* view : {"Top", "front", "Right"})
        expectRefusal(dayInAthens({"--lens", "35", "--view", view}),
                      {"--lens is for perspective views", view});
}

} // namespace
} // namespace quarn::test
