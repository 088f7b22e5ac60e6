#include "tests/host/sunpath/SvgShapes.h"
#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <cmath>
#include <filesystem>
#include <fstream>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <numbers>
#include <sstream>

namespace quarn::test {
namespace {

using testing::AllOf;
using testing::HasSubstr;
using testing::IsEmpty;

using testing::StartsWith;

using Words = std::vector<std::string>;

class SunPathRun : public testing::Test {
protected:
    Ended draw(Words options) const {
        Start start;
        start.folder = m_studio.path();
        options.insert(options.begin(), "sunpath");
        start.arguments = std::move(options);
        return run(start);
    }

    std::string svg(const std::string& name) const {
        std::ifstream file(m_studio / name);
        std::ostringstream text;
        text << file.rdbuf();
        return text.str();
    }

    void expectRefused(const Words& options, int code, const std::string& why) const {
        const Ended ended = draw(options);
        EXPECT_EQ(ended.exit_code, code);
        EXPECT_THAT(ended.err, AllOf(StartsWith("quarn: "), HasSubstr(why)));
        EXPECT_FALSE(std::filesystem::exists(m_studio / "sun.svg"));
    }

    Studio m_studio;
};

TEST_F(SunPathRun, DrawsTheYearOfAPlace) {
    const Ended ended = draw({"--place", "Berlin", "--year", "2030", "--out", "sun.svg"});
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("sun.svg: sun path of Berlin, Germany in 2030, hours of "
                                     "CET, UTC+1."));
    const std::string text = svg("sun.svg");
    EXPECT_THAT(text, StartsWith("<?xml"));
    EXPECT_THAT(text, AllOf(HasSubstr("Sun path: Berlin, Germany"), HasSubstr("52.52\xC2\xB0 N"),
                            HasSubstr("While summer time is kept (CEST) clocks show one hour "
                                      "more.")));
    EXPECT_TRUE(svgLines(text, "stereographic-12-21"));
    EXPECT_FALSE(svgLines(text, "orthographic-12-21"));
    EXPECT_FALSE(svgLines(text, "stereographic-hidden"));
}

// The tower of the house is 1 x 1, from the height 1 to 4. From 3 south of its wall, at the height
// 1, its top is 3 higher over 3: 45 degrees where one looks north. On a stereographic disk that is
// tan(22.5 degrees) of the radius.
TEST_F(SunPathRun, ShowsWhatTheModelHidesFromAPoint) {
    const Ended ended = draw({"house.obj", "--place", "Berlin", "--point", "0.5,-3,1", "--out",
                              "sun.svg", "--projection", "both"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const std::string text = svg("sun.svg");
    const auto hidden = svgLines(text, "stereographic-hidden");
    ASSERT_TRUE(hidden);
    EXPECT_TRUE(svgLines(text, "orthographic-hidden"));
    const SvgDisk disk = svgDisks(text).at(0);
    const double top = disk.radius * std::tan(std::numbers::pi / 8);
    EXPECT_TRUE(isInside(*hidden, {disk.middle.x, disk.middle.y - top - 1}));
    EXPECT_FALSE(isInside(*hidden, {disk.middle.x, disk.middle.y - top + 1}));
    EXPECT_FALSE(isInside(*hidden, {disk.middle.x, disk.middle.y + top}));
    EXPECT_THAT(text, HasSubstr("the point 0.5,-3,1 of house.obj"));
}

TEST_F(SunPathRun, SpeaksTheLanguage) {
    const Ended ended =
        draw({"--place", "Berlin", "--north", "20", "--language", "de", "--out", "sun.svg"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(svg("sun.svg"),
                AllOf(HasSubstr("Sonnenbahn: Berlin, Germany"), HasSubstr("13.41\xC2\xB0 O"),
                      HasSubstr(">21. Dez<"), HasSubstr("20\xC2\xB0 im Uhrzeigersinn")));
}

TEST_F(SunPathRun, DrawsAPicture) {
    const Ended ended = draw({"--place", "Berlin", "--projection", "both", "--out", "sun.PNG"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const auto picture = readPictureHeader(m_studio / "sun.PNG");
    ASSERT_TRUE(picture);
    EXPECT_EQ(picture->format, "png");
    EXPECT_EQ(picture->width_px, 4000);
    EXPECT_EQ(picture->height_px, 2360);
}

TEST_F(SunPathRun, LooksFromAnObjectThatHidesNothingItself) {
    const Ended ended =
        draw({"house.obj", "--place", "Berlin", "--object", "tower", "--out", "sun.svg"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    // The middle of the tower is above the hall: nothing is higher.
    const auto hidden = svgLines(svg("sun.svg"), "stereographic-hidden");
    ASSERT_TRUE(hidden);
    EXPECT_THAT(*hidden, IsEmpty());
}

TEST_F(SunPathRun, RefusesWhatMakesNoSense) {
    const Words berlin = {"--place", "Berlin", "--out", "sun.svg"};
    const auto with = [&](Words more) {
        more.insert(more.end(), berlin.begin(), berlin.end());
        return more;
    };
    expectRefused(with({"--year", "1799"}), 2, "from 1800 to 2199");
    expectRefused(with({"--year", "2200"}), 2, "from 1800 to 2199");
    expectRefused(with({"--point", "1,2,3"}), 2, "give its file too");
    expectRefused(with({"house.obj"}), 2, "--point X,Y,Z or --object NAME");
    expectRefused(with({"house.obj", "--object", "garage"}), 1, "No object is called \"garage\"");
    expectRefused(with({"missing.obj", "--point", "1,2,3"}), 1, "missing.obj");
    expectRefused({"--place", "Berlin", "--out", "sun.gif"}, 2, "sun.gif");
    expectRefused({"--place", "Berlin", "--out", "nowhere/sun.svg"}, 1, "nowhere");
    expectRefused({"--out", "sun.svg"}, 2, "say where with --place");
}

TEST_F(SunPathRun, RefusesAModelWithoutSurfaces) {
    writeFile(m_studio / "walk.obj", "v 0 0 0\nv 1 0 0\nl 1 2\n");
    expectRefused({"walk.obj", "--place", "Berlin", "--point", "0,0,0", "--out", "sun.svg"}, 1,
                  "no visible surface");
}

TEST_F(SunPathRun, KeepsAFileThatIsThereUnlessToldOtherwise) {
    writeFile(m_studio / "mine.svg", "mine");
    const Ended refused = draw({"--place", "Berlin", "--out", "mine.svg"});
    EXPECT_EQ(refused.exit_code, 1);
    EXPECT_EQ(refused.err, "quarn: mine.svg is there already: give --overwrite to replace it, or "
                           "another --out.\n");
    EXPECT_EQ(svg("mine.svg"), "mine");
    EXPECT_EQ(draw({"--place", "Berlin", "--out", "mine.svg", "--overwrite"}).exit_code, 0);
    EXPECT_THAT(svg("mine.svg"), StartsWith("<?xml"));
}

} // namespace
} // namespace quarn::test
