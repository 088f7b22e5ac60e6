#include "tests/quarn/ProgramRun.h"
#include "tests/support/TempFolder.h"

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

TEST(DayScript, SetsUpTheDefaultsOfAPlace) {
    const Words script = scriptOf(dayInAthens({}));
    ASSERT_THAT(script, SizeIs(12));
    EXPECT_THAT(Words(script.begin(), script.begin() + 3),
                ElementsAre("# Athens, Greece: 37.98 N, 23.73 E",
                            "# Clock: UTC+1, the whole hours of longitude 23.73 E, without "
                            "daylight saving",
                            "# First frame: 2026-06-21 06:00 = 05:00 UTC"));
    EXPECT_EQ(script[3], "_-Import \"town.obj\"");
    EXPECT_EQ(script[4], "_-ViewportSize 1280 720");
    EXPECT_THAT(script[5], StartsWith("_-Camera _Location "));
    EXPECT_EQ(script[6], "_-FitView _Distance 1.1 _Enter");
    EXPECT_EQ(script[7], "_-AnimationName \"town\"");
    EXPECT_EQ(script[8], "_-SetOneDaySunAnimation 37.98 23.73 0 21 6 2026 6 0 20 0 15 _jpg "
                         "_RenderedViewport _Enter _Enter");
    EXPECT_EQ(script[11], "_-RecordAnimation _TargetFolder \"out\" _Enter");
}

TEST(DayScript, HoldsEveryOption) {
    const Words script = scriptOf(
        day({"--latitude", "-33.5",      "--longitude", "-70.25", "--north",     "-12.5",
             "--date",     "2199-02-28", "--from",      "4:05",   "--to",        "21:50",
             "--every",    "7",          "--azimuth",   "0",      "--elevation", "0",
             "--distance", "2",          "--target",    "1,2,3",  "--mode",      "render preview",
             "--size",     "640x360",    "--format",    "png",    "--hide",      "Trees",
             "--up",       "y",          "--name",      "Sun",    "--save",      "sun"}));
    EXPECT_THAT(script, Contains("_-SetOneDaySunAnimation -33.5 -70.25 -12.5 28 2 2199 4 5 21 50 7 "
                                 "_png _RenderPreview _Enter _Enter"));
    EXPECT_THAT(script, Contains("_-FitView _KeepTarget=Yes _Distance 2 _Enter"));
    EXPECT_THAT(script, Contains("_-SaveAs \"sun.quarn\""));
    EXPECT_THAT(script, Contains("_-Hide \"Trees\""));
    // Behind the model at the height of the target
    EXPECT_NEAR(cameraDirection(script).azimuth_deg, 0.0, 1e-9);
    EXPECT_NEAR(cameraDirection(script).elevation_deg, 0.0, 1e-9);
}

TEST(SeasonScript, PassesWesternLongitudesPlus360) {
    EXPECT_THAT(scriptOf(seasonInTheWest({"--north", "30", "--every", "14", "--at", "15:30"})),
                Contains("_-SetSeasonalSunAnimation 39.74 254.82 30 21 3 2026 21 12 2026 15 30 14 "
                         "_jpg _RenderedViewport _Enter _Enter"));
    EXPECT_THAT(
        scriptOf(season({"--place", "Athens", "--from", "2026-03-21", "--to", "2100-12-31"})),
        Contains("_-SetSeasonalSunAnimation 37.98 23.73 0 21 3 2026 31 12 2100 12 0 7 _jpg "
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

// ---- The clock. The zone is the longitude times 24 / 360, cut toward zero.

TEST(SunStudyClock, OfADayIsTheWholeHoursOfTheLongitude) {
    const auto notes = [](const char* longitude) {
        return scriptOf(day({"--latitude", "0", "--longitude", longitude, "--date", "2026-06-21"}));
    };
    EXPECT_THAT(notes("-105.18"), Contains("# First frame: 2026-06-21 06:00 = 13:00 UTC"));
    EXPECT_THAT(notes("-105.18"), Contains("# Clock: UTC-7, the whole hours of longitude 105.18 W, "
                                           "without daylight saving"));
    EXPECT_THAT(notes("-14.9"), Contains("# First frame: 2026-06-21 06:00 = 06:00 UTC"));
    EXPECT_THAT(notes("14.9"), Contains(StartsWith("# Clock: UTC, the whole hours")));
    EXPECT_THAT(notes("15"), Contains("# First frame: 2026-06-21 06:00 = 05:00 UTC"));
    // Before midnight, universal time is on the day before.
    EXPECT_THAT(notes("151.21"),
                Contains("# First frame: 2026-06-21 06:00 = 2026-06-20 20:00 UTC"));
    EXPECT_THAT(notes("-180"), Contains("# First frame: 2026-06-21 06:00 = 18:00 UTC"));
}

/// 254.82 degrees east are 16 whole hours: noon there is 20:00 of the day before.
TEST(SunStudyClock, OfASeasonInTheWestIsADayAhead) {
    const Words script = scriptOf(seasonInTheWest({}));
    EXPECT_THAT(script, Contains("# 39.74 N, 105.18 W"));
    EXPECT_THAT(script,
                Contains("# Clock: UTC+16, the whole hours of longitude 254.82 E, without daylight "
                         "saving: the hour of UTC-8 with the next day's date"));
    EXPECT_THAT(script, Contains("# First frame: 2026-03-21 12:00 = 2026-03-20 20:00 UTC"));
}

TEST(SunStudyClock, OfASeasonInTheEastIsThatOfADay) {
    const Words script = scriptOf(season(
        {"--place", "Sydney", "--from", "2026-01-01", "--to", "2026-02-01", "--at", "9:30"}));
    EXPECT_THAT(script, Contains("# Clock: UTC+10, the whole hours of longitude 151.21 E, without "
                                 "daylight saving"));
    EXPECT_THAT(script, Contains("# First frame: 2026-01-01 09:30 = 2025-12-31 23:30 UTC"));
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
        return day({"--date", "2026-06-21", "--latitude", latitude, "--longitude", longitude});
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
                  {"--to 11:59 is before --from 12:00"});
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

TEST(SunStudyArguments, ThatMustBeThereAreNamed) {
    expectRefusal(run({"day", "town.obj", "--out", "out", "--place", "Athens"}), {"--date"});
    expectRefusal(
        run({"season", "town.obj", "--out", "out", "--place", "Athens", "--to", "2026-01-01"}),
        {"--from"});
}

// ---- Help and places

TEST(SunStudyHelp, ExplainsNorthZoneAndDaylightSaving) {
    const Ended one_day = run({"day", "--help"});
    const Ended seasonal = run({"season", "--help"});
    for (const Ended* const help : {&one_day, &seasonal}) {
        EXPECT_EQ(help->exit_code, 0);
        for (const char* word :
             {"--place", "--latitude", "--longitude", "--north", "--every", "--azimuth", "--view",
              "--mode", "--hide", "--save", "--show-script", "clockwise from the Y axis",
              "divided by 15", "daylight\nsaving do not count", "Seconds\nare always 0",
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
                ElementsAre("place         country  latitude  longitude  day    season",
                            "Athens        Greece    37.98 N   23.73 E   UTC+1  UTC+1",
                            "Thessaloniki  Greece    40.64 N   22.94 E   UTC+1  UTC+1"));
    EXPECT_THAT(run({"places", "Denver"}).out, HasSubstr("104.99 W   UTC-6  UTC+17\n"));
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
