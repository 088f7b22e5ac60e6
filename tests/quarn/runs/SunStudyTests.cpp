#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace quarn::test {
namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::SizeIs;

using Words = std::vector<std::string>;

/// A house to watch the sun around.
class Garden {
public:
    /// `quarn COMMAND house.obj` with small bitmaps.
    Ended record(const std::string& command, const Words& options,
                 const std::string& folder = "out") const {
        return recordModel("house.obj", command, options, folder);
    }

    Ended recordModel(const std::string& model, const std::string& command, const Words& options,
                      const std::string& folder) const {
        Start start;
        start.folder = m_studio.path();
        start.arguments = {command, model,      "--out", folder,       "--size",
                           "96x64", "--format", "bmp",   "--language", "en"};
        start.arguments.insert(start.arguments.end(), options.begin(), options.end());
        return run(start);
    }

    Picture picture(const std::string& name) const { return readBitmap(m_studio / name); }

    /// The dates that the page of the recording shows, in the order of its frames.
    Words datesOnPage(const std::string& page = "out/house.html") const {
        Words dates;
        for (const std::string& line : linesOf(readFile(m_studio / page)))
            if (line.starts_with("  Dates[") || line.starts_with("Dates["))
                dates.push_back(line.substr(line.find('"') + 1, 19));
        return dates;
    }

    /// "2026-06-21T14:30:00 CEST" of each frame in the list of frames.
    Words timesInManifest(const std::string& list = "out/house.frames.json") const {
        Words times;
        const auto manifest = nlohmann::json::parse(readFile(m_studio / list));
        for (const auto& image : manifest["images"])
            times.push_back(image["sun"]["time"].get<std::string>() + " " +
                            image["sun"]["zone"].get<std::string>());
        return times;
    }

    std::filesystem::path operator/(const std::filesystem::path& name) const {
        return m_studio / name;
    }

private:
    Studio m_studio;
};

/// The mean of all bytes, 0 to 255, between two rows counted from the bottom as in the file.
double brightness(const Picture& picture, int first_row, int end_row) {
    const auto row_bytes = static_cast<std::size_t>(picture.width_px) * 3;
    double sum = 0.0;
    for (std::size_t i = row_bytes * first_row; i < row_bytes * end_row; ++i)
        sum += picture.bytes[i];
    return sum / static_cast<double>(row_bytes * (end_row - first_row));
}

double brightness(const Picture& picture) {
    return brightness(picture, 0, picture.height_px);
}

// ---- A day

TEST(Day, HasAFrameAtBothEndsAndEveryStepBetween) {
    const Garden garden;
    const Ended ended = garden.record("day", {"--place", "Athens", "--date", "2026-06-21", "--from",
                                              "06:00", "--to", "18:00", "--every", "60"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const Words told = linesOf(ended.out);
    ASSERT_THAT(told, SizeIs(5));
    EXPECT_EQ(told[0], "Athens, Greece: 37.98 N, 23.73 E");
    EXPECT_EQ(told[1], "Clock: Europe/Athens, EEST (UTC+3)");
    EXPECT_EQ(told[2], "First frame: 2026-06-21 06:00 EEST = 03:00 UTC");
    EXPECT_THAT(told[4], MatchesRegex("13 frames and out/house\\.html in [0-9.]+ s"));
    EXPECT_THAT(filesIn(garden / "out"), SizeIs(16));
    const Words dates = garden.datesOnPage();
    ASSERT_THAT(dates, SizeIs(13));
    // The page is on the whole hours of the longitude, the list of frames on the wall's clock.
    EXPECT_EQ(dates.front(), "2026-06-21 04:00:00");
    EXPECT_EQ(dates[1], "2026-06-21 05:00:00");
    EXPECT_EQ(dates.back(), "2026-06-21 16:00:00");
    const Words times = garden.timesInManifest();
    ASSERT_THAT(times, SizeIs(13));
    EXPECT_EQ(times.front(), "2026-06-21T06:00:00 EEST");
    EXPECT_EQ(times.back(), "2026-06-21T18:00:00 EEST");
    EXPECT_THAT(readFile(garden / "out/house.html"), HasSubstr("bDisplayDate = 1;"));
}

/// The program counts the frames before the plug-in does; both must agree, or a whole recording
/// would be told to be a part.
TEST(Day, CountsItsFramesBeforehand) {
    struct Case {
        const char* from;
        const char* to;
        const char* every;
        std::size_t frames;
    };
    const Garden garden;
    // 1439 / 97 = 14.8; 37 / 37 = 1; 36 / 37 < 1
    for (const Case& c : {Case{"00:00", "23:59", "97", 15}, Case{"11:11", "11:48", "37", 2},
                          Case{"11:11", "11:47", "37", 1}, Case{"00:00", "23:59", "1440", 1},
                          Case{"23:58", "23:59", "1", 2}}) {
        const Ended ended =
            garden.record("day", {"--latitude", "0", "--longitude", "-20", "--date", "2024-02-29",
                                  "--from", c.from, "--to", c.to, "--every", c.every});
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_THAT(garden.datesOnPage(), SizeIs(c.frames)) << c.from;
    }
}

/// In Auckland the clock of studies is UTC+11, and in summer the clock on the wall UTC+13: its
/// first two hours belong to the day before. The last picture is that of a study on one date.
TEST(Day, ThatFallsOnTwoDatesOfTheStudiesClockIsOneRecording) {
    const Garden garden;
    const Words site = {"--place", "Auckland", "--date", "2026-12-21", "--to", "07:00"};
    const auto from = [&](const char* time, const char* folder) {
        Words options = site;
        options.insert(options.end(), {"--from", time, "--every", "360"});
        const Ended ended = garden.record("day", options, folder);
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
    };
    from("01:00", "both");
    from("07:00", "one");
    EXPECT_THAT(garden.datesOnPage("both/house.html"),
                ElementsAre("2026-12-20 23:00:00", "2026-12-21 05:00:00"));
    EXPECT_THAT(garden.timesInManifest("both/house.frames.json"),
                ElementsAre("2026-12-21T01:00:00 NZDT", "2026-12-21T07:00:00 NZDT"));
    EXPECT_TRUE(readFile(garden / "both/house001.bmp") == readFile(garden / "one/house000.bmp"));
}

/// The document keeps whose clocks its study goes by.
TEST(Day, OfASavedDocumentIsToldByTheSameClock) {
    const Garden garden;
    const Ended saved =
        garden.record("day", {"--place", "Kolkata", "--date", "2026-06-21", "--from", "06:15",
                              "--to", "06:15", "--save", "kept.quarn"});
    ASSERT_EQ(saved.exit_code, 0) << saved.err;
    Start start;
    start.folder = (garden / "").parent_path();
    start.arguments = {"record", "kept.quarn", "--out", "again"};
    const Ended ended = run(start);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(garden.timesInManifest("again/house.frames.json"),
                ElementsAre("2026-06-21T06:15:00 IST"));
}

TEST(Day, IsDarkAtNightAndItsShadowsMove) {
    const Garden garden;
    // Night, morning, noon, afternoon in Athens
    const Ended ended = garden.record("day", {"--place", "Athens", "--date", "2026-06-21", "--from",
                                              "01:00", "--to", "19:00", "--every", "360"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const Picture night = garden.picture("out/house000.bmp");
    const Picture morning = garden.picture("out/house001.bmp");
    const Picture noon = garden.picture("out/house002.bmp");
    const Picture evening = garden.picture("out/house003.bmp");
    EXPECT_LT(brightness(night), 0.6 * brightness(noon));
    EXPECT_GT(brightness(night), 5.0);
    EXPECT_GT(meanDifference(morning, evening), 0.02);
    EXPECT_GT(meanDifference(noon, evening), 0.02);
}

/// On 21 December the noon sun stands 28.6 degrees high in the south of Athens, so that the tower
/// of 4 draws a shadow of 7.3 to the north: upward in a plan. In Sydney it is the other way round
/// in June, and where north is turned by half a circle.
TEST(Day, ShadowsFallAwayFromTheNoonSun) {
    const Garden garden;
    const auto north_minus_south = [&](const Words& site) {
        Words options = {"--from", "12:00", "--to", "12:00", "--view", "Top", "--distance", "3"};
        options.insert(options.end(), site.begin(), site.end());
        const Ended ended = garden.record("day", options);
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        const Picture plan = garden.picture("out/house000.bmp");
        const int middle = plan.height_px / 2;
        return brightness(plan, middle, plan.height_px) - brightness(plan, 0, middle);
    };
    const double in_the_north = north_minus_south({"--place", "Athens", "--date", "2026-12-21"});
    const double in_the_south = north_minus_south({"--place", "Sydney", "--date", "2026-06-21"});
    const double turned =
        north_minus_south({"--place", "Athens", "--date", "2026-12-21", "--north", "180"});
    EXPECT_LT(in_the_north, in_the_south - 2.0);
    EXPECT_LT(in_the_north, turned - 2.0);
}

TEST(Day, OfADocumentIsSeenByItsOwnCamera) {
    const Garden garden;
    const Words noon = {"--place", "Athens", "--date", "2026-06-21", "--from",
                        "12:00",   "--to",   "12:00",  "--name",     "Noon"};
    Words first = noon;
    first.insert(first.end(), {"--azimuth", "40", "--elevation", "20", "--save", "kept.quarn"});
    ASSERT_EQ(garden.record("day", first).exit_code, 0);
    ASSERT_EQ(garden.recordModel((garden / "kept.quarn").string(), "day", noon, "again").exit_code,
              0);
    EXPECT_TRUE(readFile(garden / "out/Noon000.bmp") == readFile(garden / "again/Noon000.bmp"));
    ASSERT_EQ(garden.record("day", noon, "usual").exit_code, 0);
    EXPECT_GT(
        meanDifference(garden.picture("out/Noon000.bmp"), garden.picture("usual/Noon000.bmp")),
        0.01);
}

TEST(Day, SaysWhichViewThereIsNot) {
    const Garden garden;
    const Ended ended =
        garden.record("day", {"--place", "Athens", "--date", "2026-06-21", "--view", "Balcony"});
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("Balcony"));
    EXPECT_FALSE(std::filesystem::exists(garden / "out"));
}

// ---- A season

TEST(Season, HasAFrameOnEveryDateToTheLastOne) {
    const Garden garden;
    const Ended ended =
        garden.record("season", {"--place", "Athens", "--from", "2026-03-21", "--to", "2026-12-21",
                                 "--every", "55", "--at", "15:30"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    // 55 days after 21 March is 15 May, then 9 July, 2 September, 27 October, 21 December.
    EXPECT_THAT(garden.datesOnPage(),
                ElementsAre("2026-03-21 14:30:00", "2026-05-15 14:30:00", "2026-07-09 14:30:00",
                            "2026-09-02 14:30:00", "2026-10-27 14:30:00", "2026-12-21 14:30:00"));
    EXPECT_THAT(garden.timesInManifest(),
                ElementsAre("2026-03-21T15:30:00 EET", "2026-05-15T16:30:00 EEST",
                            "2026-07-09T16:30:00 EEST", "2026-09-02T16:30:00 EEST",
                            "2026-10-27T15:30:00 EET", "2026-12-21T15:30:00 EET"));
    EXPECT_THAT(filesIn(garden / "out"), SizeIs(9));
    EXPECT_THAT(linesOf(ended.out), Contains("First frame: 2026-03-21 15:30 EET = 13:30 UTC"));
    EXPECT_GT(
        meanDifference(garden.picture("out/house002.bmp"), garden.picture("out/house005.bmp")),
        0.01);
}

/// At 105.18 degrees west a season is set up on UTC+16 and a day on UTC-7. 12:00 of standard time
/// on 21 March is 13:00 on the wall, and 19:00 universal time: the pictures are of the same sun.
TEST(Season, InTheWestShowsTheSunOfItsDates) {
    const Garden garden;
    const auto west = [](Words options) {
        options.insert(options.end(), {"--latitude", "39.74", "--longitude", "-105.18"});
        return options;
    };
    const Ended season = garden.record(
        "season", west({"--from", "2026-03-21", "--to", "2026-03-21", "--at", "12:00"}), "season");
    const Ended day = garden.record(
        "day", west({"--date", "2026-03-21", "--from", "13:00", "--to", "13:00"}), "day");
    ASSERT_EQ(season.exit_code, 0) << season.err;
    ASSERT_EQ(day.exit_code, 0) << day.err;
    for (const Ended* const ended : {&season, &day})
        EXPECT_THAT(ended->out, HasSubstr("First frame: 2026-03-21 13:00 MDT = 19:00 UTC"));
    EXPECT_EQ(garden.timesInManifest("season/house.frames.json"),
              garden.timesInManifest("day/house.frames.json"));
    EXPECT_LT(
        meanDifference(garden.picture("season/house000.bmp"), garden.picture("day/house000.bmp")),
        0.001);
}

TEST(SunStudy, ThatIsRefusedLeavesNoFolder) {
    const Garden garden;
    const Ended ended = garden.record(
        "day", {"--place", "Athens", "--date", "2026-06-21", "--from", "12:00", "--to", "11:00"});
    EXPECT_EQ(ended.exit_code, 2);
    EXPECT_THAT(ended.out, IsEmpty());
    EXPECT_FALSE(std::filesystem::exists(garden / "out"));
}

TEST(SunStudy, ShownScriptRunsAsItIs) {
    const Garden garden;
    const Ended shown = garden.record(
        "day", {"--place", "Athens", "--date", "2026-06-21", "--every", "400", "--show-script"});
    writeFile(garden / "steps.txt", shown.out);
    std::filesystem::create_directory(garden / "out");
    Start start;
    start.folder = (garden / "").parent_path();
    start.arguments = {"run", "steps.txt"};
    const Ended ended = run(start);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(filesIn(garden / "out"),
                ElementsAre("house.frames.json", "house.html", "house.recording", "house000.bmp",
                            "house001.bmp", "house002.bmp"));
}

} // namespace
} // namespace quarn::test
