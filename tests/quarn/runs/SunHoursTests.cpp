#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>

#include <fstream>
#include <sstream>

namespace quarn::test {
namespace {

using testing::AllOf;
using testing::HasSubstr;

Start sunHours(const Studio& studio, const std::vector<std::string>& options) {
    Start start;
    start.folder = studio.path();
    start.arguments = {"sunhours", "house.obj", "--out", "out", "--size", "96x64"};
    start.arguments.insert(start.arguments.end(), options.begin(), options.end());
    return start;
}

std::string textOf(const std::filesystem::path& file) {
    std::ifstream stream(file, std::ios::binary);
    std::ostringstream text;
    text << stream.rdbuf();
    return text.str();
}

TEST(SunHoursTests, PlanOfADayIsAPictureAPageNumbersAndATable) {
    const Studio studio;
    const Ended ended = run(sunHours(
        studio, {"--place", "Athens", "--date", "2026-03-21", "--view", "plan", "--grid", "0.5"}));
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("known to 5 min"));
    for (const char* const extension : {"png", "npy", "csv", "html", "ply"})
        EXPECT_GT(std::filesystem::file_size(studio / "out" /
                                             (std::string("house-sunhours.") + extension)),
                  60U)
            << extension;
    const std::string page = textOf(studio / "out/house-sunhours.html");
    EXPECT_THAT(page, HasSubstr("Athens, Greece"));
    EXPECT_THAT(page, HasSubstr("\"12:00 EET\""));
    EXPECT_EQ(page.find("{{"), page.npos);
    EXPECT_THAT(textOf(studio / "out/house-sunhours.csv"), HasSubstr("share_from_2_hours"));
}

/// Picture and page of a plan in a language.
struct Sheet {
    std::string picture;
    std::string page;
};

Sheet sheetIn(const std::string& language) {
    const Studio studio;
    const Ended ended =
        run(sunHours(studio, {"--place", "Athens", "--date", "2026-03-21", "--every", "120",
                              "--view", "plan", "--language", language}));
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    return {textOf(studio / "out/house-sunhours.png"), textOf(studio / "out/house-sunhours.html")};
}

TEST(SunHoursTests, SheetIsInTheLanguageAndItsPictureInEnglishWhereTheFontLacksLetters) {
    const Sheet english = sheetIn("en");
    const Sheet german = sheetIn("de");
    const Sheet japanese = sheetIn("ja");
    EXPECT_THAT(german.page, AllOf(HasSubstr("<html lang=\"de\">"), HasSubstr("Sonnenstunden"),
                                   HasSubstr("21. M\xC3\xA4r 2026")));
    EXPECT_THAT(japanese.page, AllOf(HasSubstr("<html lang=\"ja\">"), HasSubstr("2026\xE5\xB9\xB4"
                                                                                "3\xE6\x9C\x88"
                                                                                "21\xE6\x97\xA5")));
    EXPECT_NE(german.picture, english.picture);
    EXPECT_EQ(japanese.picture, english.picture);
}

TEST(SunHoursTests, PolarNightIsToldAndHasNoHours) {
    const Studio studio;
    const Ended ended = run(sunHours(studio, {"--latitude", "78.2", "--longitude", "15.6", "--date",
                                              "2026-12-21", "--view", "plan"}));
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("The sun does not rise there in this time"));
    EXPECT_THAT(textOf(studio / "out/house-sunhours.csv"), HasSubstr(",0.000,0.0000,"));
}

TEST(SunHoursTests, MistakesAreToldBeforeAnythingIsRead) {
    const Studio studio;
    const auto misuse = [&](std::vector<std::string> options) {
        options.insert(options.end(), {"--place", "Athens"});
        const Ended ended = run(sunHours(studio, options));
        EXPECT_EQ(ended.exit_code, 2) << ended.err;
        return ended.err;
    };
    EXPECT_THAT(misuse({"--date", "2026-02-30"}), HasSubstr("a day of the calendar"));
    EXPECT_THAT(misuse({"--date", "2026-03-21", "--every", "0"}), HasSubstr("--every"));
    EXPECT_THAT(misuse({"--date", "2026-03-21", "--from", "15:00", "--to", "09:00"}),
                HasSubstr("--to is not after --from"));
    EXPECT_THAT(misuse({"--date", "2026-03-21", "--to-date", "2026-03-20"}),
                HasSubstr("is before --date"));
    EXPECT_THAT(misuse({"--date", "2026-03-21", "--from", "sunset", "--to", "sunrise"}),
                HasSubstr("--to is not after --from"));
    EXPECT_THAT(misuse({"--date", "2026-03-29", "--from", "03:30"}),
                HasSubstr("--from 03:30 on 2026-03-29 does not exist in Europe/Athens"));
    EXPECT_THAT(misuse({"--date", "2026-03-21", "--zone", "Europe/Nowhere"}), HasSubstr("--zone"));
    EXPECT_FALSE(std::filesystem::exists(studio / "out"));
}

TEST(SunHoursTests, ModelWithoutSurfacesIsRefusedAndWritesNothing) {
    const Studio studio;
    std::ofstream(studio / "house.obj") << "v 0 0 0\nv 1 1 0\nl 1 2\n";
    const Ended ended =
        run(sunHours(studio, {"--place", "Athens", "--date", "2026-03-21", "--view", "plan"}));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_FALSE(std::filesystem::exists(studio / "out/house-sunhours.png"));
}

TEST(SunHoursTests, DayAndTimesMayBeThoseOfTheSun) {
    const Studio studio;
    const Ended ended =
        run(sunHours(studio, {"--place", "Athens", "--date", "solstice-june-2026", "--from",
                              "sunrise+1h", "--to", "sunset-1h", "--view", "plan"}));
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    // The sun is up for some 14 h 49 min that day.
    EXPECT_THAT(ended.out, HasSubstr("at most 12 h 4"));
    const std::string page = textOf(studio / "out/house-sunhours.html");
    EXPECT_THAT(page, HasSubstr("21 Jun 2026"));
    // The sun's upper edge rises at 6:02 and sets at 20:51.
    EXPECT_THAT(page, testing::ContainsRegex("07:0[123] to 19:5[012] .EEST"));
}

TEST(SunHoursTests, PlaceByCoordinatesIsToldWhoseClocksItGoesBy) {
    const Studio studio;
    const Ended ended = run(sunHours(studio, {"--latitude", "37.9", "--longitude", "23.7", "--date",
                                              "2026-03-21", "--view", "plan"}));
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("The clock is that of Athens, Greece, the nearest city known; "
                                     "--zone takes another.\n"));
}

TEST(SunHoursTests, FilesThatAreThereStayUnlessToldOtherwise) {
    const Studio studio;
    std::filesystem::create_directory(studio / "out");
    std::ofstream(studio / "out/house-sunhours.csv") << "mine";
    std::vector<std::string> options = {"--place", "Athens", "--date", "2026-12-21",
                                        "--every", "60",     "--view", "plan"};
    const Ended refused = run(sunHours(studio, options));
    EXPECT_EQ(refused.exit_code, 1);
    EXPECT_EQ(refused.err, "quarn: out/house-sunhours.csv is there already: give --overwrite to "
                           "replace it, or another --out.\n");
    EXPECT_EQ(textOf(studio / "out/house-sunhours.csv"), "mine");
    EXPECT_FALSE(std::filesystem::exists(studio / "out/house-sunhours.png"));
    options.push_back("--overwrite");
    EXPECT_EQ(run(sunHours(studio, options)).exit_code, 0);
    EXPECT_NE(textOf(studio / "out/house-sunhours.csv"), "mine");
}

} // namespace
} // namespace quarn::test
