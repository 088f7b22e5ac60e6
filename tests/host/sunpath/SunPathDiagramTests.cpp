#include "host/sunpath/SunPathDiagram.h"
#include "host/sunpath/SvgText.h"
#include "tests/host/sunpath/SvgShapes.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <map>
#include <numbers>
#include <ostream>

namespace quarn {
namespace {

using std::chrono::days;
using std::chrono::hours;
using std::chrono::minutes;
using testing::HasSubstr;
using testing::Not;
using testing::SizeIs;

constexpr double RADIANS_PER_DEGREE = std::numbers::pi / 180;

SunPathWish wishFor(const SunSite& site, int zone_hours) {
    return {.place = "Somewhere",
            .site = site,
            .clock = {2026, hours(zone_hours)},
            .clock_name = "XST, UTC",
            .summer_time = {},
            .projections = {SkyProjection::stereographic, SkyProjection::orthographic},
            .north_deg = {},
            .point = {}};
}

std::string twoDigits(unsigned number) {
    return (number < 10 ? "0" : "") + std::to_string(number);
}

/// Where a sun belongs on a disk whose zenith is in the middle, north up and east to the right.
SvgPoint placeOf(const SvgDisk& disk, bool is_stereographic, const SunPosition& sun) {
    const double altitude = sun.altitude_deg * RADIANS_PER_DEGREE;
    const double azimuth = sun.azimuth_deg * RADIANS_PER_DEGREE;
    const double radius =
        disk.radius *
        (is_stereographic ? std::cos(altitude) / (1 + std::sin(altitude)) : std::cos(altitude));
    return {disk.middle.x + radius * std::sin(azimuth), disk.middle.y - radius * std::cos(azimuth)};
}

struct Place {
    const char* name;
    SunSite site;
    int zone_hours;

    friend void PrintTo(const Place& place, std::ostream* out) { *out << place.name; }
};

/// Drawn once: some thousand positions of the sun take their time.
const std::string& diagramOf(const Place& place) {
    static std::map<std::string, std::string> drawn;
    std::string& svg = drawn[place.name];
    if (svg.empty())
        svg = svgText(sunPathDiagram(wishFor(place.site, place.zone_hours), {}));
    return svg;
}

constexpr Place BERLIN = {"Berlin", {52.52, 13.41}, 1};
constexpr Place LONGYEARBYEN = {"Longyearbyen", {78.22, 15.64}, 1};

class SunPathDiagram : public testing::TestWithParam<Place> {
protected:
    /// A part of the diagram shows the sun at an instant within half a pixel, on both disks.
    void expectShown(const std::vector<std::string>& ids, std::chrono::sys_seconds time) const {
        const SunPosition sun = sunPosition(GetParam().site, time);
        if (sun.altitude_deg < 0)
            return;
        for (const bool is_stereographic : {true, false}) {
            SvgLines lines;
            for (const std::string& id : ids) {
                const auto found =
                    svgLines(m_svg, (is_stereographic ? "stereographic-" : "orthographic-") + id);
                if (found)
                    lines.insert(lines.end(), found->begin(), found->end());
            }
            const SvgPoint place =
                placeOf(m_disks[is_stereographic ? 0 : 1], is_stereographic, sun);
            EXPECT_LE(distanceTo(lines, place), 0.5)
                << ids.front() << " azimuth " << sun.azimuth_deg << " altitude "
                << sun.altitude_deg;
        }
    }

    const std::string& m_svg = diagramOf(GetParam());
    std::vector<SvgDisk> m_disks = svgDisks(m_svg);
};

TEST_P(SunPathDiagram, DaysPassThroughTheSunWithinHalfAPixel) {
    ASSERT_THAT(m_disks, SizeIs(2));
    for (unsigned month = 1; month <= 12; ++month) {
        const auto midnight =
            std::chrono::sys_days(std::chrono::year(2026) / std::chrono::month(month) / 21) -
            hours(GetParam().zone_hours);
        for (minutes time(0); time < hours(24); time += minutes(53))
            expectShown({twoDigits(month) + "-21"}, midnight + time);
    }
}

TEST_P(SunPathDiagram, LoopsPassThroughTheSunOfTheirHourWithinHalfAPixel) {
    ASSERT_THAT(m_disks, SizeIs(2));
    for (unsigned hour = 0; hour < 24; ++hour) {
        const std::string id = "hour-" + twoDigits(hour);
        for (auto day = std::chrono::sys_days(std::chrono::year(2026) / 1 / 1);
             day < std::chrono::sys_days(std::chrono::year(2026) / 12 / 21); day += days(29))
            expectShown({id, id + "-back"}, day + hours(hour) - hours(GetParam().zone_hours));
    }
}

/// The sun does not stand elsewhere either: no line of a day leaves what the sun goes through.
TEST_P(SunPathDiagram, DaysShowNothingButTheSun) {
    ASSERT_THAT(m_disks, SizeIs(2));
    for (unsigned month = 1; month <= 12; month += 5) {
        const auto lines = svgLines(m_svg, "stereographic-" + twoDigits(month) + "-21");
        if (!lines)
            continue;
        SvgLines sun(1);
        const auto midnight =
            std::chrono::sys_days(std::chrono::year(2026) / std::chrono::month(month) / 21) -
            hours(GetParam().zone_hours);
        for (minutes time(0); time <= hours(24); time += minutes(3))
            sun[0].push_back(
                placeOf(m_disks[0], true, sunPosition(GetParam().site, midnight + time)));
        for (const auto& line : *lines)
            for (const SvgPoint& point : line) {
                EXPECT_LE(distanceTo(sun, point), 0.5);
                EXPECT_LE(std::hypot(point.x - m_disks[0].middle.x, point.y - m_disks[0].middle.y),
                          m_disks[0].radius + 0.02);
            }
    }
}

INSTANTIATE_TEST_SUITE_P(Places, SunPathDiagram,
                         testing::Values(BERLIN, Place{"Sydney", {-33.87, 151.21}, 10},
                                         Place{"Singapore", {1.29, 103.85}, 8}, LONGYEARBYEN,
                                         Place{"pole", {90, 0}, 0}),
                         [](const auto& place) { return std::string(place.param.name); });

TEST(PolarDiagram, HasNoLineForADayWithoutSunAndSaysSo) {
    const std::string& svg = diagramOf(LONGYEARBYEN);
    EXPECT_FALSE(svgLines(svg, "stereographic-12-21"));
    EXPECT_TRUE(svgLines(svg, "stereographic-06-21"));
    EXPECT_THAT(svg, HasSubstr("The sun does not rise on the 21st of: Jan, Nov, Dec."));
    EXPECT_THAT(diagramOf(BERLIN), Not(HasSubstr("does not rise")));
}

TEST(SvgText, EscapesTextsAndStaysUtf8) {
    Drawing drawing{.width_px = 9, .height_px = 9, .title = "T", .shapes = {}};
    drawing.shapes.push_back(
        DrawnText{.place = {1, 2}, .text = "A & B <\"C\"> S\xC3\xA3o \xFF\x01", .size_px = 3});
    const std::string svg = svgText(drawing);
    EXPECT_THAT(svg, HasSubstr("A &amp; B &lt;&quot;C&quot;&gt; S\xC3\xA3o "));
    EXPECT_THAT(svg, Not(HasSubstr("\xFF")));
    EXPECT_THAT(svg, Not(HasSubstr("\x01")));
}

TEST(DiagramText, TellsTheClockAndNorth) {
    SunPathWish wish = wishFor({52.52, 13.41}, 1);
    wish.clock_name = "CET, UTC+1";
    wish.summer_time = SummerTime{"CEST", hours(1)};
    wish.north_deg = -20;
    const std::string svg = svgText(sunPathDiagram(wish, {}));
    EXPECT_THAT(svg, HasSubstr("hours of standard time, CET, UTC+1<"));
    EXPECT_THAT(svg, HasSubstr("While summer time is kept (CEST) clocks show one hour more."));
    EXPECT_THAT(svg, HasSubstr("North lies 20\xC2\xB0 anticlockwise from the model's Y axis"));
}

} // namespace
} // namespace quarn
