#include "host/sun/SunDirection.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"

#include <cmath>
#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::Not;

class SunCommandTest : public HostTest {
protected:
    DocumentSun& sun() { return Document::of(session.document()).sun(); }
    SunPosition position() { return positionOfSun(sun().directionToSun()); }

    void expectDirection(double x, double y, double z) {
        const KM_3dVector& direction = sun().directionToSun();
        EXPECT_NEAR(direction.x, x, 1e-12);
        EXPECT_NEAR(direction.y, y, 1e-12);
        EXPECT_NEAR(direction.z, z, 1e-12);
    }

    /// Runs a line that cannot be done; the sun must stay on the spot and on or off.
    void expectRefused(const wchar_t* line, const std::string& message) {
        SCOPED_TRACE(KM_wString(line).ToUtf8());
        const KM_3dVector direction = sun().directionToSun();
        const bool enabled = sun().isEnabled();
        front_end.clearPrinted();
        EXPECT_NE(run(line), CQuarnCommand::success);
        EXPECT_THAT(printed(), HasSubstr(message));
        EXPECT_EQ(sun().directionToSun(), direction);
        EXPECT_EQ(sun().isEnabled(), enabled);
    }
};

TEST_F(SunCommandTest, TurnsTheSunOffAndOnWhereItStands) {
    const KM_3dVector direction = sun().directionToSun();
    ASSERT_EQ(run(L"_-Sun _Off"), CQuarnCommand::success);
    EXPECT_FALSE(sun().isEnabled());
    EXPECT_EQ(printed(), "sun: off, azimuth 135, altitude 45\n");
    ASSERT_EQ(run(L"_-Sun _On"), CQuarnCommand::success);
    EXPECT_TRUE(sun().isEnabled());
    EXPECT_EQ(sun().directionToSun(), direction);
}

TEST_F(SunCommandTest, EnterShowsTheSunAndChangesNothing) {
    const KM_3dVector direction = sun().directionToSun();
    ASSERT_EQ(run(L"_-Sun _Enter"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "sun: on, azimuth 135, altitude 45\n");
    EXPECT_EQ(sun().directionToSun(), direction);
}

// Azimuth clockwise from the Y axis: 90 is the X axis, 180 minus Y, 270 minus X.
TEST_F(SunCommandTest, ADirectionIsClockwiseFromTheYAxisAndAboveTheHorizon) {
    const double half = std::sqrt(0.5);
    const struct {
        const wchar_t* line;
        double x, y, z;
    } directions[] = {
        {L"Sun Direction 0 0", 0, 1, 0},
        {L"Sun Direction 90 0", 1, 0, 0},
        {L"Sun Direction 180 45", 0, -half, half},
        {L"Sun Direction -90 0", -1, 0, 0},
        {L"Sun Direction 270 0", -1, 0, 0},
        {L"Sun Direction 360 0", 0, 1, 0},
        {L"Sun Direction -360 -45", 0, half, -half},
        {L"Sun Direction 77 90", 0, 0, 1},
        {L"Sun Direction 30 -90", 0, 0, -1},
        {L"Sun Direction 30 0", 0.5, std::sqrt(0.75), 0},
    };
    for (const auto& [line, x, y, z] : directions) {
        ASSERT_EQ(run(line), CQuarnCommand::success) << KM_wString(line).ToUtf8();
        expectDirection(x, y, z);
    }
}

TEST_F(SunCommandTest, ASunThatIsPutSomewhereIsTurnedOn) {
    run(L"Sun Off");
    ASSERT_EQ(run(L"_-Sun _Direction 200.5 -3"), CQuarnCommand::success);
    EXPECT_TRUE(sun().isEnabled());
    EXPECT_THAT(printed(), HasSubstr("sun: on, azimuth 200.5, altitude -3\n"
                                     "The sun is below the horizon: nothing is in its light.\n"));
    run(L"Sun Off");
    ASSERT_EQ(run(L"_-Sun _PlaceAndTime Cairo 2026-06-21 12:00"), CQuarnCommand::success);
    EXPECT_TRUE(sun().isEnabled());
}

TEST_F(SunCommandTest, EnterKeepsTheAngleThatIsThere) {
    run(L"Sun Direction 100 20");
    ASSERT_EQ(run(L"_-Sun _Direction _Enter 60"), CQuarnCommand::success);
    EXPECT_NEAR(position().azimuth_deg, 100, 1e-9);
    EXPECT_NEAR(position().altitude_deg, 60, 1e-9);
}

TEST_F(SunCommandTest, AnglesBeyondTheirLimitsAreRefused) {
    expectRefused(L"Sun Direction 361 10", "Enter a number from -360 to 360");
    expectRefused(L"Sun Direction 10 90.1", "Enter a number from -90 to 90");
    expectRefused(L"Sun Direction east 10", "\"east\" does not answer");
    expectRefused(L"Sun Sideways", "\"Sideways\" is no option here. The options are On, Off, "
                                   "Direction, PlaceAndTime.");
}

// I. Reda and A. Andreas, Solar Position Algorithm for Solar Radiation Applications
// (NREL/TP-560-34302), appendix A.5: azimuth 194.34024, altitude before refraction 39.872046.
TEST_F(SunCommandTest, StandsWhereThePublishedExamplePutsIt) {
    ASSERT_EQ(run(L"_-Sun _PlaceAndTime 39.742476 -105.1786 2003-10-17T12:30:30 _TimeZone -7 "
                  L"_Enter"),
              CQuarnCommand::success);
    EXPECT_NEAR(position().azimuth_deg, 194.34024, 0.001);
    EXPECT_NEAR(position().altitude_deg, 39.872046, 0.001);
    EXPECT_EQ(printed(), "latitude 39.74, longitude -105.18\n"
                         "2003-10-17 12:30:30 UTC-7 is 2003-10-17 19:30:30 universal time\n"
                         "azimuth 194.34 from north, altitude 39.87\n"
                         "sun: on, azimuth 194.34, altitude 39.87\n");
}

TEST_F(SunCommandTest, NorthIsTurnedClockwiseFromTheYAxis) {
    ASSERT_EQ(run(L"_-Sun _PlaceAndTime 39.742476 -105.1786 2003-10-17T12:30:30 _TimeZone -7 "
                  L"_NorthAngle 30 _Enter"),
              CQuarnCommand::success);
    EXPECT_NEAR(position().azimuth_deg, 194.34024 + 30, 0.001);
    EXPECT_THAT(printed(), HasSubstr("azimuth 194.34 from north"));
    EXPECT_THAT(printed(), HasSubstr("sun: on, azimuth 224.34, altitude 39.87\n"));
    run(L"Sun PlaceAndTime 39.742476 -105.1786 2003-10-17T12:30:30 TimeZone -7 NorthAngle -200");
    EXPECT_NEAR(position().azimuth_deg, 194.34024 - 200 + 360, 0.001);
}

TEST_F(SunCommandTest, TheZoneIsTheWholeHoursOfTheLongitudeUnlessAnotherIsGiven) {
    const struct {
        const wchar_t* line;
        const char* told;
    } zones[] = {
        {L"Sun PlaceAndTime 0 14.99 2026-01-01 00:30", "UTC is 2026-01-01 00:30:00 universal"},
        {L"Sun PlaceAndTime 0 15 2026-01-01 00:30", "UTC+1 is 2025-12-31 23:30:00 universal"},
        {L"Sun PlaceAndTime 0 -14.99 2026-01-01 00:30", "UTC is 2026-01-01 00:30:00 universal"},
        {L"Sun PlaceAndTime 0 -105.2 2026-12-31 20:00", "UTC-7 is 2027-01-01 03:00:00 universal"},
        {L"Sun PlaceAndTime 0 180 2026-01-01 00:30", "UTC+12 is 2025-12-31 12:30:00 universal"},
        {L"Sun PlaceAndTime Mumbai 2026-06-21 12:00 TimeZone 5.5",
         "UTC+5:30 is 2026-06-21 06:30:00 universal"},
        {L"Sun PlaceAndTime \"St. John's\" 2026-06-21 12:00 TimeZone -3.5",
         "UTC-3:30 is 2026-06-21 15:30:00 universal"},
    };
    for (const auto& [line, told] : zones) {
        front_end.clearPrinted();
        EXPECT_EQ(run(line), CQuarnCommand::success) << KM_wString(line).ToUtf8();
        EXPECT_THAT(printed(), HasSubstr(told));
    }
}

TEST_F(SunCommandTest, TheSameMomentInAnotherZoneIsTheSameSun) {
    ASSERT_EQ(run(L"Sun PlaceAndTime Mumbai 2026-06-21 01:15 TimeZone 0"), CQuarnCommand::success);
    const KM_3dVector direction = sun().directionToSun();
    for (const wchar_t* line : {L"Sun PlaceAndTime Mumbai 2026-06-21 06:45 TimeZone 5.5",
                                L"Sun PlaceAndTime Mumbai 2026-06-20 21:45 TimeZone -3.5",
                                L"Sun PlaceAndTime Mumbai 2026-06-21 00:45 TimeZone -0.5",
                                L"Sun PlaceAndTime Mumbai 2026-06-22 01:00 TimeZone 23.75"}) {
        ASSERT_EQ(run(line), CQuarnCommand::success);
        EXPECT_LT((sun().directionToSun() - direction).Length(), 1e-6) << KM_wString(line).ToUtf8();
    }
}

TEST_F(SunCommandTest, DateAndTimeAreReadInEveryWrittenForm) {
    for (const wchar_t* line : {L"Sun PlaceAndTime London 2026-06-21 14:30",
                                L"Sun PlaceAndTime London \"2026-06-21 14:30\"",
                                L"Sun PlaceAndTime London 2026-06-21T14:30:00",
                                L"Sun PlaceAndTime london 2026-6-21t14:30 _Enter",
                                L"Sun PlaceAndTime 51.51 -0.13 2026-06-21 14:30:00 _Enter"}) {
        front_end.clearPrinted();
        ASSERT_EQ(run(line), CQuarnCommand::success) << KM_wString(line).ToUtf8();
        EXPECT_THAT(printed(), HasSubstr("latitude 51.51, longitude -0.13\n"
                                         "2026-06-21 14:30:00 UTC is 2026-06-21 14:30:00 "
                                         "universal time\n"));
    }
}

TEST_F(SunCommandTest, ACityIsTakenInAnySpellingAndToldByItsOwnName) {
    ASSERT_EQ(run(L"Sun PlaceAndTime \"sao paulo\" 2026-06-21 12:00"), CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr("São Paulo, Brazil: latitude -23.55, longitude -46.63\n"));
    front_end.clearPrinted();
    ASSERT_EQ(run(L"Sun PlaceAndTime \"Birmingham, United States\" 2026-06-21 12:00"),
              CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr("Birmingham, United States: latitude 33.52"));
}

TEST_F(SunCommandTest, ACityThatIsNotInTheListIsToldWithWhatMayBeMeant) {
    expectRefused(L"Sun PlaceAndTime Lodnon 2026-06-21 12:00",
                  "There is no city \"Lodnon\" in the list. Is it one of these: "
                  "London, United Kingdom?");
    expectRefused(L"Sun PlaceAndTime Birmingham 2026-06-21 12:00",
                  "Several cities are called \"Birmingham\": Birmingham, United Kingdom; "
                  "Birmingham, United States.");
    expectRefused(L"Sun PlaceAndTime Xqzzwvk 2026-06-21 12:00",
                  "There is no city \"Xqzzwvk\" in the list. A name with blanks");
    EXPECT_THAT(printed(), Not(HasSubstr("one of these")));
}

TEST_F(SunCommandTest, ATimeOrPlaceThatDoesNotExistIsToldAndChangesNothing) {
    expectRefused(L"Sun PlaceAndTime London 2026-04-31 12:00",
                  "\"2026-04-31\" is a date that the calendar does not have.");
    expectRefused(L"Sun PlaceAndTime London 2026-02-29 12:00", "calendar does not have");
    expectRefused(L"Sun PlaceAndTime London \"2026-13-01 12:00\"", "calendar does not have");
    expectRefused(L"Sun PlaceAndTime London 1799-12-31 12:00",
                  "the sun is known for the years 1800 to 2199");
    expectRefused(L"Sun PlaceAndTime London 2200-01-01 12:00", "years 1800 to 2199");
    expectRefused(L"Sun PlaceAndTime London 21.6.2026 12:00", "\"21.6.2026\" is no date.");
    expectRefused(L"Sun PlaceAndTime London 2026-06-21 24:00", "\"24:00\" is no time of day.");
    expectRefused(L"Sun PlaceAndTime London 2026-06-21T12:60", "\"12:60\" is no time of day.");
    expectRefused(L"Sun PlaceAndTime London 2026-06-21T", "\"\" is no time of day.");
    expectRefused(L"Sun PlaceAndTime London 2026-06-21 noon", "\"noon\" is no time of day.");
    expectRefused(L"Sun PlaceAndTime 91 0 2026-06-21 12:00",
                  "A latitude is a number from -90 to 90, not 91.");
    expectRefused(L"Sun PlaceAndTime 51 181 2026-06-21 12:00", "Enter a number from -180 to 180");
    expectRefused(L"Sun PlaceAndTime London 2026-06-21 12:00 TimeZone 24.1 _Enter",
                  "Enter a number from -24 to 24");
    expectRefused(L"Sun PlaceAndTime London 2026-06-21 12:00 NorthAngle 361 _Enter",
                  "Enter a number from -360 to 360");
    expectRefused(L"Sun PlaceAndTime London 2026-06-21 12:00 Sideways",
                  "\"Sideways\" is no option here. The options are TimeZone, NorthAngle.");
    expectRefused(L"_-Sun _PlaceAndTime London", "Date and time");
}

TEST_F(SunCommandTest, ThereIsASunFromTheFirstMinuteToTheLastInEveryZone) {
    for (const wchar_t* line : {L"Sun PlaceAndTime 0 0 1800-01-01 00:00 TimeZone 5.5",
                                L"Sun PlaceAndTime 0 0 1800-01-01 00:00 TimeZone -5.5",
                                L"Sun PlaceAndTime 0 0 1800-01-01 00:00 TimeZone 24",
                                L"Sun PlaceAndTime 0 0 2199-12-31 23:59:59 TimeZone -23.5",
                                L"Sun PlaceAndTime 0 0 2199-12-31 23:59:59 TimeZone 23.5",
                                L"Sun PlaceAndTime -90 -180 2199-12-31 23:59:59 TimeZone -24"})
        EXPECT_EQ(run(line), CQuarnCommand::success) << KM_wString(line).ToUtf8();
}

TEST_F(SunCommandTest, ASunBelowTheHorizonIsSetAndTold) {
    ASSERT_EQ(run(L"Sun PlaceAndTime London 2026-12-21 22:00"), CQuarnCommand::success);
    EXPECT_LT(position().altitude_deg, -40);
    EXPECT_THAT(printed(), HasSubstr("The sun is below the horizon: nothing is in its light.\n"));
    front_end.clearPrinted();
    run(L"Sun PlaceAndTime London 2026-12-21 12:00");
    EXPECT_THAT(printed(), Not(HasSubstr("below the horizon")));
}

TEST_F(SunCommandTest, APersonIsAskedAgainForWhatCannotBe) {
    for (const wchar_t* answer : {L"_PlaceAndTime", L"Lodnon", L"London", L"2026-04-31",
                                  L"2026-04-30", L"25:00", L"12:00", L"_Enter"})
        front_end.addAnswer(answer);
    ASSERT_EQ(session.runTypedCommand(L"Sun"), CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr("London, United Kingdom?"));
    EXPECT_THAT(printed(), HasSubstr("2026-04-30 12:00:00 UTC"));
}

TEST(SunDirection, IsTheInverseOfThePosition) {
    for (const double azimuth : {0.0, 1e-9, 12.0, 90.0, 179.0, 180.0, 270.0, 359.999}) {
        for (const double altitude : {-89.0, -10.0, 0.0, 45.0, 89.9}) {
            const SunPosition back = positionOfSun(directionToSun({azimuth, altitude}));
            EXPECT_NEAR(back.azimuth_deg, azimuth, 1e-9);
            EXPECT_NEAR(back.altitude_deg, altitude, 1e-9);
        }
    }
    EXPECT_EQ(positionOfSun({0, 0, 1}).azimuth_deg, 0);
    EXPECT_EQ(positionOfSun({-1e-18, 1, 0}).azimuth_deg, 0);
}

} // namespace
} // namespace quarn::test
