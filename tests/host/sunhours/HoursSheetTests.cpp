#include "engine/display/DisplayScene.h"
#include "host/sunhours/HourColors.h"
#include "host/sunhours/HoursPicture.h"
#include "host/sunhours/HoursSheet.h"
#include "host/sunhours/PlanView.h"
#include "tests/engine/sunhours/SunHoursFixture.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn {
namespace {

using namespace std::chrono;

constexpr double RADIANS = std::numbers::pi / 180.0;

SunHoursRequest planRequest(int width_px, int height_px) {
    SunHoursRequest request;
    request.title = "yard";
    request.first_day = request.last_day = 2026y / March / 21;
    request.is_plan = true;
    request.width_px = width_px;
    request.height_px = height_px;
    return request;
}

/// Where the ink of the north arrow has its middle, on a sheet around an empty map.
PicturePlace middleOfArrow(double north_deg) {
    Image map;
    map.resize(400, 200);
    std::ranges::fill(map.rgba, std::uint8_t{255});
    SunHoursRequest request = planRequest(400, 200);
    request.site.north_deg = north_deg;
    const TextPainter text(Letters::read(programFont()).value());
    const Image sheet = sheetOf(map, request, {}, text);
    double ink = 0;
    double across = 0;
    double down = 0;
    for (int y = 0; y < 50; ++y)
        for (int x = sheet.width - 60; x < sheet.width; ++x) {
            const double dark = 255 - sheet.pixel(x, y)[1];
            ink += dark;
            across += dark * x;
            down += dark * y;
        }
    EXPECT_GT(ink, 0);
    return {static_cast<float>(across / ink), static_cast<float>(down / ink)};
}

TEST(HoursSheetTests, ArrowOfAPlanPointsNorth) {
    const PicturePlace up = middleOfArrow(0);
    const PicturePlace right = middleOfArrow(90);
    const PicturePlace down = middleOfArrow(180);
    const PicturePlace left = middleOfArrow(270);
    EXPECT_LT(up.y + 1, down.y);
    EXPECT_LT(left.x + 1, right.x);
    const PicturePlace between = middleOfArrow(45);
    EXPECT_GT(between.x, up.x + 0.3);
    EXPECT_LT(between.y, right.y - 0.3);
}

/// The sun of the equator at the equinox: up in the east, through the zenith, down in the west.
SunMoments equinox() {
    SunMoments moments;
    moments.days = 1;
    moments.hours = 12.0;
    for (double turn_deg = 0.25; turn_deg < 180; turn_deg += 0.5)
        moments.moments.push_back(
            {{}, {{std::cos(turn_deg * RADIANS), 0, std::sin(turn_deg * RADIANS)}, 0.5 / 15}});
    return moments;
}

/// The columns of the middle row that lines of equal hours go through.
std::vector<int> columnsOfLines(double isoline_hours) {
    SceneContent content;
    addMesh(content, floorMesh(-50, -50, 50, 50, 0));
    addMesh(content, wallMesh({3, -50, 0}, {3, 50, 0}, 3));
    DisplayScene scene;
    EXPECT_TRUE(scene.update(content));
    KM_BoundingBox box;
    box.Set(KM_3dPoint(-4, -3.5, 0));
    box.Set(KM_3dPoint(3, 3.5, 3));
    constexpr int SIDE_PX = 140; // twenty to a unit
    SunHoursRequest request = planRequest(SIDE_PX, SIDE_PX);
    request.isoline_hours = isoline_hours;
    const KM_Viewport view = planView(box, SIDE_PX, SIDE_PX);
    const SunMoments moments = equinox();
    const auto watch = [](double) { return true; };
    const auto map = mapOf(scene, view, request, moments, watch);
    const auto picture = colouredMap(scene, view, request, moments, *map, watch);
    constexpr int BLUER_THAN_THE_SCALE = 200;
    std::vector<int> columns;
    for (int x = 0; x + 10 < SIDE_PX; ++x) // the wall itself is at the end
        if (picture->pixel(x, SIDE_PX / 2)[2] > BLUER_THAN_THE_SCALE)
            columns.push_back(x);
    return columns;
}

// A wall in the east, 3 high and so far away that its top stands at 45, 30 and 60 degrees, takes 3,
// 2 and 4 hours of 12: it stands at 3, and these places are at 0, -2.196 and 1.268.
TEST(HoursSheetTests, LinesOfEqualHoursAreWhereTheHoursAreWhole) {
    EXPECT_THAT(columnsOfLines(0), testing::IsEmpty());
    const std::vector<int> columns = columnsOfLines(1);
    for (const double line : {-2.196, 0.0, 1.268}) {
        const double column = 20 * (line + 4);
        EXPECT_TRUE(std::ranges::any_of(columns, [&](int found) {
            return std::abs(found + 0.5 - column) < 2;
        })) << column;
    }
    EXPECT_LT(columns.size(), 12U);
}

TEST(HoursSheetTests, WordsTellWhatWasAskedFor) {
    SunHoursRequest request = planRequest(8, 8);
    SunMoments moments = equinox();
    request.site.place = "Quito, Ecuador";
    request.site.zone = Zone::fixed(hours(-5));
    EXPECT_EQ(titleOf(request, {}), "Hours of sun · yard");
    EXPECT_EQ(subtitleOf(request, moments, {}),
              "Quito, Ecuador · 21 Mar 2026 (UTC-5) · at most 12 h of sun");
    request.from = WantedTime{WantedTime::Since::sunrise, minutes(0)};
    for (SunMoment& moment : moments.moments)
        moment.time = sys_days(2026y / March / 21) + hours(11) + minutes(20); // 06:20 there
    EXPECT_THAT(subtitleOf(request, moments, {}), testing::HasSubstr(" · 06:20 to 24:00 (UTC-5)"));
    request.last_day = 2026y / December / 31;
    request.every_days = 7;
    request.every_minutes = 15;
    moments.days = 41;
    moments.hours = 11.25;
    EXPECT_THAT(subtitleOf(request, moments, {}),
                testing::AllOf(testing::HasSubstr("21 Mar 2026 to 31 Dec 2026, every 7 days"),
                               testing::HasSubstr("sunrise to 24:00"),
                               testing::HasSubstr("11 h 15 min")));
    EXPECT_EQ(
        legendOf(request, moments, {}),
        "Hours of direct sun a day, mean of the days; steps of 15 minutes, each begin and end "
        "of sun is known to 8 min. Colours: viridis.");
}

} // namespace
} // namespace quarn
