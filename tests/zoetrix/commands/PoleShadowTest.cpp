#include "tests/zoetrix/fixtures/RecordedPicture.h"
#include "tests/zoetrix/fixtures/SunFixture.h"
#include "zoetrix/sun/VyrSun.h"

#include <algorithm>
#include <cmath>

// The whole way of a sun study, from the questions to the pixels of the recorded frames: a vertical
// pole on level ground, seen straight from above, whose shadow is measured in the frames.

namespace {

constexpr double radians_per_degree = KM_PI / 180.0;

constexpr double pole_height = 4.0;
constexpr double pole_half_width = 0.2; ///< four pixels: its edges are edges of pixels
constexpr double view_half_width = 15.0;
constexpr int size_px = 600;
constexpr double pixel = 2.0 * view_half_width / size_px; ///< 0.05 model units

/// How far the end of a measured shadow may lie from where it must be: a quarter of a pixel. The
/// middle of some hundred or thousand pixels is known better than any of them, and 0.03 degrees of
/// the sun's altitude move the end of the longest shadow here so far.
constexpr double tolerance = 0.25 * pixel;

/// Ground from edge to edge of the picture, and the pole at its middle.
constexpr const char* pole_on_ground = "o ground\n"
                                       "v -40 -40 0\nv 40 -40 0\nv 40 40 0\nv -40 40 0\n"
                                       "f 1 2 3 4\n"
                                       "o pole\n"
                                       "v -0.2 -0.2 0\nv 0.2 -0.2 0\nv 0.2 0.2 0\nv -0.2 0.2 0\n"
                                       "v -0.2 -0.2 4\nv 0.2 -0.2 4\nv 0.2 0.2 4\nv -0.2 0.2 4\n"
                                       "f 5 6 10 9\nf 6 7 11 10\nf 7 8 12 11\nf 8 5 9 12\n"
                                       "f 9 10 11 12\nf 8 7 6 5\n";

/// Where a pole's tip casts its shadow, seen from its foot: away from the sun, as long as the pole
/// is high over the tangent of the altitude.
KM_3dVector shadowUnder(double azimuth_deg, double altitude_deg, double north_angle_deg = 0.0) {
    const double length = pole_height / std::tan(altitude_deg * radians_per_degree);
    // North is the model's Y axis turned clockwise by the north angle.
    const double bearing = (azimuth_deg + north_angle_deg) * radians_per_degree;
    return {-length * std::sin(bearing), -length * std::cos(bearing), 0.0};
}

/// A place and a clock for the plug-in's own calculator, which the studies do not use.
struct Observer {
    double latitude;
    double longitude;
    int zone_hours;
};

KM_3dVector shadowAt(const Observer& observer, const Moment& moment, double north_angle_deg) {
    CVyrSun sun;
    EXPECT_TRUE(sun.SetLatitude(observer.latitude) && sun.SetLongitude(observer.longitude) &&
                sun.SetTimeZoneHours(observer.zone_hours) &&
                sun.SetLocalDateTime(moment.year, moment.month, moment.day,
                                     moment.hour + moment.minute / 60.0));
    EXPECT_GT(sun.Altitude(), 20.0) << "the shadow must end in the picture";
    return shadowUnder(sun.Azimuth(), sun.Altitude(), north_angle_deg);
}

/// The place of a pixel's middle on the ground.
KM_3dVector placeOf(int x, int y) {
    return {(x + 0.5) * pixel - view_half_width, view_half_width - (y + 0.5) * pixel, 0.0};
}

bool isUnderThePole(const KM_3dVector& place) {
    return std::abs(place.x) < pole_half_width && std::abs(place.y) < pole_half_width;
}

/// Light from a byte of a picture, 0 to 1 (IEC 61966-2-1, for all but the darkest bytes): where a
/// pixel lies in shadow in part, its light is shared so, and not its byte.
double lightOf(double byte) {
    return std::pow((byte / 255.0 + 0.055) / 1.055, 2.4);
}

/// A shadow as it was found in a picture.
struct MeasuredShadow {
    KM_3dVector reach;     ///< from the pole's foot to where its tip casts its shadow
    double area = 0.0;     ///< of shadow and foot together, in square model units
    double darkness = 0.0; ///< of the shadow against the lit ground, 0 to 1
    double farthest = 0.0; ///< distance of the farthest pixel in shadow from the middle of the foot
};

/// Shadow and foot together are what the foot sweeps over on its way along the reach, which is
/// alike about the middle of that way. So the middle of all their pixels is half of the reach.
MeasuredShadow measure(const RecordedPicture& picture) {
    std::vector<std::uint8_t> sorted = picture.bytes;
    std::ranges::sort(sorted);
    const double lit = lightOf(sorted[sorted.size() / 2]); // Most of the picture is lit ground.
    const double dark = lightOf(sorted.front());
    MeasuredShadow shadow;
    shadow.darkness = (lit - dark) / lit;
    double covered = 0.0;
    KM_3dVector sum(0.0, 0.0, 0.0);
    for (int y = 0; y < picture.height_px; ++y) {
        for (int x = 0; x < picture.width_px; ++x) {
            const KM_3dVector place = placeOf(x, y);
            const double in_shadow = (lit - lightOf(picture.at(x, y))) / (lit - dark);
            if (in_shadow > 0.5)
                shadow.farthest = std::max(shadow.farthest, place.Length());
            const double share = isUnderThePole(place) ? 1.0 : std::clamp(in_shadow, 0.0, 1.0);
            covered += share;
            sum = sum + place * share;
        }
    }
    shadow.reach = sum * (2.0 / covered);
    shadow.area = covered * pixel * pixel;
    return shadow;
}

class PoleShadow : public SunFixture {
protected:
    void SetUp() override;

    /// Records the study that is set up.
    std::vector<RecordedPicture> recordedFrames();
    void expectShadow(const RecordedPicture& picture, const KM_3dVector& expected);
    /// That the study has a frame for each moment, with the shadow of that moment.
    void expectShadows(const Observer& observer, double north_angle_deg,
                       const std::vector<Moment>& moments);
};

void PoleShadow::SetUp() {
    SunFixture::SetUp();
    importObj(pole_on_ground);
    ASSERT_EQ(CQuarnCommand::success, run(L"StandardView Top"));
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 600 600"));
    CQuarnViewport& viewport = QuarnApp().ActiveView()->MainViewport();
    KM_Viewport down = viewport.VP();
    ASSERT_TRUE(down.IsParallelProjection());
    ASSERT_TRUE(down.SetCameraLocation({0.0, 0.0, 50.0}) && down.SetTargetPoint({0.0, 0.0, 0.0}) &&
                down.SetFrustum(-view_half_width, view_half_width, -view_half_width,
                                view_half_width, 1.0, 100.0));
    ASSERT_TRUE(viewport.SetVP(down, true, true));
    ASSERT_TRUE(near(viewport.VP().CameraX(), KM_3dVector(1.0, 0.0, 0.0), 1e-15));
    ASSERT_TRUE(near(viewport.VP().CameraY(), KM_3dVector(0.0, 1.0, 0.0), 1e-15));
    record().SetFileExtension(L"png");
}

std::vector<RecordedPicture> PoleShadow::recordedFrames() {
    EXPECT_EQ(CQuarnCommand::success, run(L"RecordAnimation _Enter"));
    EXPECT_EQ(record().FrameCount(), record().Images().Count());
    std::vector<RecordedPicture> pictures;
    for (const KM_wString& name : record().Images()) {
        pictures.push_back(readPng(folder.path() / "frames" / name.ToUtf8()));
        EXPECT_EQ(size_px, pictures.back().width_px) << name.ToUtf8();
        EXPECT_EQ(size_px, pictures.back().height_px) << name.ToUtf8();
    }
    return pictures;
}

void PoleShadow::expectShadow(const RecordedPicture& picture, const KM_3dVector& expected) {
    const MeasuredShadow found = measure(picture);
    EXPECT_GT(found.darkness, 0.3);
    const double length = expected.Length();
    const KM_3dVector along = expected * (1.0 / length);
    const KM_3dVector across(-along.y, along.x, 0.0);
    EXPECT_NEAR(length, found.reach * along, tolerance) << "length";
    EXPECT_NEAR(0.0, found.reach * across, tolerance) << "direction";
    // The foot is as wide as this, seen along the shadow; its farthest corner leads.
    const double width = 2.0 * pole_half_width * (std::abs(along.x) + std::abs(along.y));
    EXPECT_NEAR(length * width + 4.0 * pole_half_width * pole_half_width, found.area,
                0.01 * length * width);
    EXPECT_NEAR(length + width / 2.0, found.farthest, 1.5 * pixel);
}

void PoleShadow::expectShadows(const Observer& observer, double north_angle_deg,
                               const std::vector<Moment>& moments) {
    const std::vector<RecordedPicture> pictures = recordedFrames();
    ASSERT_EQ(moments.size(), pictures.size());
    for (std::size_t k = 0; k < moments.size(); ++k) {
        SCOPED_TRACE(KM_wString(textOf(moments[k]).c_str()).ToUtf8());
        expectShadow(pictures[k], shadowAt(observer, moments[k], north_angle_deg));
    }
}

} // namespace

TEST_F(PoleShadow, OfAPublishedMomentLiesAsThePublishedSunSays) {
    // I. Reda and A. Andreas, Solar Position Algorithm for Solar Radiation Applications, NREL
    // 2003, appendix A.5: 17 October 2003, 12:30:30, seven hours behind universal time, azimuth
    // 194.34024, altitude before refraction 39.87205. The frames are those of the whole minutes
    // before and after. Each lies an eighth of a degree of hour angle from it, which is a tenth of
    // a pixel along the shadow and a quarter of one across, so its shadow is the middle of the two.
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.latitude = L"39.742476",
                                                       .longitude = L"-105.1786",
                                                       .day = L"17",
                                                       .month = L"10",
                                                       .year = L"2003",
                                                       .start_hour = L"12",
                                                       .start_minute = L"30",
                                                       .end_hour = L"12",
                                                       .end_minute = L"31",
                                                       .minutes = L"1"}));
    const std::vector<RecordedPicture> pictures = recordedFrames();
    ASSERT_EQ(2U, pictures.size());
    const KM_3dVector found = (measure(pictures[0]).reach + measure(pictures[1]).reach) * 0.5;
    EXPECT_TRUE(near(found, shadowUnder(194.34024, 39.87205), tolerance));
}

TEST_F(PoleShadow, GoesRoundThroughTheSouthOnASouthernSummersDay) {
    // In Sydney the zone is ten hours, of 151.2093 / 15 = 10.08. The sun passes in the north.
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.latitude = L"-33.8688",
                                                       .longitude = L"151.2093",
                                                       .day = L"21",
                                                       .month = L"12",
                                                       .year = L"2025",
                                                       .start_hour = L"8",
                                                       .end_hour = L"16",
                                                       .minutes = L"120"}));
    expectShadows({-33.8688, 151.2093, 10}, 0.0,
                  {{2025, 12, 21, 8},
                   {2025, 12, 21, 10},
                   {2025, 12, 21, 12},
                   {2025, 12, 21, 14},
                   {2025, 12, 21, 16}});
}

TEST_F(PoleShadow, TurnsClockwiseWithTheNorthAngle) {
    // Near the equator in May; -78.5 / 15 = -5.23 hours are five.
    ASSERT_EQ(CQuarnCommand::success, setUp(DayAnswers{.latitude = L"-0.22",
                                                       .longitude = L"-78.51",
                                                       .north_angle = L"-75",
                                                       .day = L"1",
                                                       .month = L"5",
                                                       .start_hour = L"9",
                                                       .end_hour = L"15",
                                                       .minutes = L"180"}));
    expectShadows({-0.22, -78.51, -5}, -75.0,
                  {{2026, 5, 1, 9}, {2026, 5, 1, 12}, {2026, 5, 1, 15}});
}

TEST_F(PoleShadow, ShortensAndLengthensOverANorthernSeason) {
    // Reykjavik lies at 21.94 degrees west, which is 338.06 east: there the zone is 22 hours ahead,
    // and its clock shows the time of two hours behind universal time of the day before.
    ASSERT_EQ(CQuarnCommand::success, setUp(SeasonAnswers{.latitude = L"64.1466",
                                                          .longitude = L"338.06",
                                                          .north_angle = L"30",
                                                          .start_day = L"1",
                                                          .start_month = L"4",
                                                          .end_day = L"28",
                                                          .end_month = L"9",
                                                          .hour = L"11",
                                                          .minute = L"15",
                                                          .days = L"60"}));
    std::vector<Moment> moments;
    for (int k = 0; k < 4; ++k)
        moments.push_back(daysAfter({2026, 3, 31, 11, 15}, 60 * k));
    EXPECT_EQ(L"2026-04-01 11:15:00", dates().front());
    expectShadows({64.1466, -21.94, -2}, 30.0, moments);
}
