#include "tests/quarn/ProgramRun.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace quarn::test {
namespace {

using testing::AllOf;
using testing::Contains;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;
using testing::StartsWith;

using Words = std::vector<std::string>;

std::string told(Words options) {
    options.insert(options.begin(), "sun");
    const Ended ended = run(options);
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.err, IsEmpty());
    return ended.out;
}

void expectRefused(Words options, const std::string& why) {
    options.insert(options.begin(), "sun");
    const Ended ended = run(options);
    EXPECT_EQ(ended.exit_code, 2) << ended.out;
    EXPECT_THAT(ended.out, IsEmpty());
    EXPECT_THAT(ended.err, AllOf(StartsWith("quarn: "), HasSubstr(why)));
}

// United States Naval Observatory, "Sunrise/Sunset/Moonrise/Moonset for one year" (2019), 60 N 0 E
// on 21 June: 02:36 and 21:28.
TEST(SunReport, TellsTheRiseAndSetOfThePublishedTable) {
    const std::string text =
        told({"--latitude", "60", "--longitude", "0", "--zone", "UTC", "--date", "2019-06-21"});
    EXPECT_THAT(text, HasSubstr("rise        02:36 UTC"));
    EXPECT_THAT(text, HasSubstr("set         21:28 UTC"));
    EXPECT_THAT(text, HasSubstr("day length  18 h 5"));
    EXPECT_THAT(linesOf(text), Contains(StartsWith("2019-06-21 23:00 UTC")));
}

// I. Reda and A. Andreas, Solar Position Algorithm for Solar Radiation Applications, appendix A.5:
// azimuth 194.34, altitude 39.872 at 12:30:30 by clocks 7 hours behind UTC; at 12:30 and 12:31 the
// azimuth is some tenths of a degree less and more.
TEST(SunReport, TellsThePositionOfThePublishedExample) {
    const auto json = nlohmann::json::parse(
        told({"--latitude", "39.742476", "--longitude", "-105.1786", "--zone", "-7", "--time",
              "2003-10-17 12:30", "--to", "12:31", "--every", "1", "--format", "json"}));
    ASSERT_THAT(json["positions"], SizeIs(2));
    const double before = json["positions"][0]["azimuth_deg"];
    const double after = json["positions"][1]["azimuth_deg"];
    EXPECT_NEAR((before + after) / 2, 194.34024, 0.001);
    EXPECT_NEAR((json["positions"][0]["altitude_deg"].get<double>() +
                 json["positions"][1]["altitude_deg"].get<double>()) /
                    2,
                39.872046, 0.001);
    EXPECT_EQ(json["positions"][0]["time"], "2003-10-17T12:30:00-07:00");
}

TEST(SunReport, TellsTheTimeOnTheWall) {
    EXPECT_THAT(told({"--place", "Berlin", "--time", "2026-06-21 14:30"}),
                HasSubstr("\n2026-06-21 14:30 CEST "));
    EXPECT_THAT(told({"--place", "Berlin", "--time", "2026-01-21T14:30"}),
                HasSubstr("\n2026-01-21 14:30 CET "));
    EXPECT_THAT(told({"--place", "Berlin", "--date", "2026-03-29", "--format", "csv"}),
                AllOf(HasSubstr("\n2026-03-29T01:00:00+01:00,"),
                      HasSubstr("\n2026-03-29T03:00:00+02:00,")));
}

TEST(SunReport, TableHasARowForEachTimeWithTheRiseAndSetOfItsDay) {
    const Words rows = linesOf(told({"--place", "Athens", "--time", "2026-06-21 22:00", "--to",
                                     "2026-06-22 02:00", "--every", "60", "--format", "csv"}));
    ASSERT_THAT(rows, SizeIs(6));
    EXPECT_EQ(rows[0], "time,azimuth_deg,altitude_deg,rise,transit,set,day_length_h");
    EXPECT_THAT(rows[2],
                AllOf(StartsWith("2026-06-21T23:00:00+03:00,"), HasSubstr(",2026-06-21T06:0")));
    EXPECT_THAT(rows[3],
                AllOf(StartsWith("2026-06-22T00:00:00+03:00,"), HasSubstr(",2026-06-22T06:0")));
}

TEST(SunReport, TellsPolarDayAndPolarNight) {
    const Words far = {"--latitude", "78.2", "--longitude", "15.6", "--date"};
    Words june = far;
    june.push_back("2026-06-21");
    Words december = far;
    december.push_back("2026-12-21");
    EXPECT_THAT(told(june), HasSubstr("day length  24 h 00 min, polar day"));
    EXPECT_THAT(told(december), HasSubstr("day length  0 h 00 min, polar night"));
}

TEST(SunReport, TellsWhoseZoneCoordinatesGet) {
    EXPECT_THAT(told({"--latitude", "52.4", "--longitude", "13.3", "--date", "2026-06-21"}),
                AllOf(HasSubstr("\nClock: Europe/Berlin\n"),
                      HasSubstr("The clock is that of Berlin, Germany, the nearest city known; "
                                "--zone takes another.\n")));
}

TEST(SunReport, TellsOfATimeThatComesTwice) {
    EXPECT_THAT(
        told({"--place", "Berlin", "--time", "2026-10-25 02:30"}),
        AllOf(HasSubstr("02:30 on 2026-10-25 comes twice: --time takes the first, 02:30 CEST.\n"),
              HasSubstr("\n2026-10-25 02:30 CEST")));
}

// As above: 02:36 and 21:28.
TEST(SunReport, TakesDaysAndTimesByName) {
    const std::string text =
        told({"--latitude", "60", "--longitude", "0", "--zone", "UTC", "--date",
              "solstice-june-2019", "--time", "sunrise+1h", "--to", "sunset-1h", "--every", "30"});
    EXPECT_THAT(text, HasSubstr("\n2019-06-21\n"));
    EXPECT_THAT(linesOf(text), Contains(StartsWith("2019-06-21 03:3")));
    EXPECT_THAT(linesOf(text), Contains(StartsWith("2019-06-21 20:0")));
    EXPECT_THAT(told({"--place", "Berlin", "--time", "solstice-december-2019 12:00"}),
                HasSubstr("\n2019-12-22 12:00 CET"));
}

TEST(SunReport, RefusesWhatMakesNoSense) {
    const auto refused = [](const Words& options, const std::string& why) {
        Words all = {"--place", "Berlin"};
        all.insert(all.end(), options.begin(), options.end());
        expectRefused(all, why);
    };
    refused({"--time", "2026-03-29 02:30"}, "--time 02:30 on 2026-03-29 does not exist");
    refused({"--date", "2026-04-31"}, "a day of the calendar");
    refused({"--date", "1799-12-31"}, "in the years 1800 to 2199");
    refused({"--time", "2200-01-01 12:00"}, "in the years 1800 to 2199");
    refused({"--date", "solstice-june-1799"}, "in the years 1800 to 2199");
    refused({"--date", "solstice-july"}, "a date such as 2026-06-21, today, or a day such as");
    refused({"--time", "noon"}, "a time such as 14:30");
    refused({"--time", "2026-06-21 14:00", "--to", "13:00"}, "--to is before --time");
    refused({"--date", "2026-06-21", "--to", "13:00"}, "--to goes with --time");
    refused({"--date", "2026-06-21", "--time", "2026-06-21 13:00"}, "not twice");
    refused({"--date", "2026-06-21", "--every", "0"}, "--every must be a whole number");
    refused({"--zone", "Europe/Berlyn"}, "Europe/Berlin");
    refused({"--latitude", "3"}, "give either --place");
    refused({"--time", "1800-01-01 00:00", "--to", "2199-12-31 00:00", "--every", "1"},
            "give a larger --every");
    expectRefused({}, "say where with --place");
    expectRefused({"--latitude", "3"}, "go together");
    expectRefused({"--place", "Birmingham"}, "United States");
    expectRefused({"--place", "Atlantis"}, "quarn places");
}

} // namespace
} // namespace quarn::test
