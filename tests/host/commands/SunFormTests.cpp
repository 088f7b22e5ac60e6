#include "host/commands/SunForm.h"
#include "host/sun/SunDirection.h"
#include "tests/host/commands/HostFormFixture.h"

namespace quarn::test {
namespace {

using testing::HasSubstr;

class SunFormTest : public FormTest {
protected:
    DocumentSun& sun() { return document().sun(); }
    SunPosition position() { return positionOfSun(sun().directionToSun()); }
    void expectPosition(double azimuth_deg, double altitude_deg, double tolerance_deg) {
        EXPECT_NEAR(position().azimuth_deg, azimuth_deg, tolerance_deg);
        EXPECT_NEAR(position().altitude_deg, altitude_deg, tolerance_deg);
    }
    /// The worked example of Ibrahim Reda and Afshin Andreas, Solar Position Algorithm for Solar
    /// Radiation Applications (NREL/TP-560-34302), appendix A.5: azimuth 194.34024, altitude before
    /// refraction 39.872046.
    static void enterExample(HeadlessDialogWindow& form) {
        form.type(SunForm::latitude_id, L"39.742476");
        form.type(SunForm::longitude_id, L"-105.1786");
        form.choose(SunForm::date_id, {2003, 10, 17, 0, 0, 0});
        form.choose(SunForm::time_id, {2003, 10, 17, 12, 30, 30});
    }
    static constexpr double EXAMPLE_AZIMUTH_DEG = 194.34024;
    static constexpr double EXAMPLE_ALTITUDE_DEG = 39.872046;
    static constexpr double EXAMPLE_TOLERANCE_DEG = 0.001;
};

TEST_F(SunFormTest, ShowsWhereTheSunStandsAndChangesNothingByItself) {
    const KM_3dVector direction = sun().directionToSun();
    const auto ended = answer(L"_Sun", [](HeadlessDialogWindow& form) {
        EXPECT_EQ(form.form().title.View(), L"Sun");
        EXPECT_EQ(form.entries(SunForm::sun_id), (std::vector<std::wstring>{L"On", L"Off"}));
        EXPECT_EQ(form.pickedEntry(SunForm::sun_id), SunForm::on);
        EXPECT_EQ(form.text(SunForm::latitude_id), L"51.28"); // of a record without a study
        EXPECT_EQ(form.text(SunForm::longitude_id), L"0");
        EXPECT_EQ(form.dateTime(SunForm::date_id), COleDateTime(2010, 6, 1, 12, 0, 0));
        EXPECT_EQ(form.text(SunForm::azimuth_id), L"135");
        EXPECT_EQ(form.text(SunForm::altitude_id), L"45");
        form.pressOk();
    });
    EXPECT_EQ(ended, CQuarnCommand::success);
    EXPECT_EQ(sun().directionToSun(), direction);
    EXPECT_EQ(printed(), "sun: on, azimuth 135, altitude 45\n");
}

TEST_F(SunFormTest, TurnsTheSunOffAndOn) {
    for (const int state : {SunForm::off, SunForm::on}) {
        answer(L"_Sun", [&](HeadlessDialogWindow& form) {
            EXPECT_NE(form.pickedEntry(SunForm::sun_id), state);
            form.pick(SunForm::sun_id, state);
            form.pressOk();
        });
        EXPECT_EQ(sun().isEnabled(), state == SunForm::on);
    }
}

TEST_F(SunFormTest, AnglesPutTheSunClockwiseFromTheYAxis) {
    answer(L"_Sun", [](HeadlessDialogWindow& form) {
        form.type(SunForm::azimuth_id, L"270");
        form.type(SunForm::altitude_id, L"0");
        form.pressOk();
    });
    EXPECT_NEAR(sun().directionToSun().x, -1, 1e-12);
    EXPECT_EQ(printed(), "sun: on, azimuth 270, altitude 0\n");
}

TEST_F(SunFormTest, PlaceAndTimeCountWithoutTheirButton) {
    answer(L"_Sun", [](HeadlessDialogWindow& form) {
        enterExample(form);
        form.type(SunForm::zone_id, L"-7");
        form.pressOk();
    });
    expectPosition(EXAMPLE_AZIMUTH_DEG, EXAMPLE_ALTITUDE_DEG, EXAMPLE_TOLERANCE_DEG);
    EXPECT_THAT(printed(), HasSubstr("2003-10-17 12:30:30 UTC-7 is 2003-10-17 19:30:30"));
}

TEST_F(SunFormTest, ButtonShowsTheAnglesOfThePlaceAndTime) {
    answer(L"_Sun", [](HeadlessDialogWindow& form) {
        enterExample(form);
        EXPECT_TRUE(form.click(SunForm::compute_button_id));
        EXPECT_EQ(form.text(SunForm::azimuth_id), L"194.34");
        EXPECT_EQ(form.text(SunForm::altitude_id), L"39.87");
        form.pressOk();
    });
    expectPosition(EXAMPLE_AZIMUTH_DEG, EXAMPLE_ALTITUDE_DEG, EXAMPLE_TOLERANCE_DEG);
    EXPECT_NE(position().altitude_deg, 39.87);
}

// 105.1786 / 15 is 7.01: whole hours that the clocks are behind.
TEST_F(SunFormTest, EmptyZoneIsThatOfTheLongitude) {
    answer(L"_Sun", [](HeadlessDialogWindow& form) {
        EXPECT_EQ(form.text(SunForm::zone_id), L"");
        enterExample(form);
        form.type(SunForm::zone_id, L"  ");
        form.pressOk();
    });
    EXPECT_EQ(sun().lastPlaceAndTime()->clock.zone_minutes, -7 * 60);
}

TEST_F(SunFormTest, NorthAngleTurnsTheSunClockwise) {
    answer(L"_Sun", [](HeadlessDialogWindow& form) {
        enterExample(form);
        form.type(SunForm::north_angle_id, L"180");
        form.click(SunForm::compute_button_id);
        EXPECT_EQ(form.text(SunForm::azimuth_id), L"14.34");
        form.pressOk();
    });
    expectPosition(EXAMPLE_AZIMUTH_DEG - 180, EXAMPLE_ALTITUDE_DEG, EXAMPLE_TOLERANCE_DEG);
}

TEST_F(SunFormTest, AnglesThatWereEnteredCountBeforePlaceAndTime) {
    answer(L"_Sun", [](HeadlessDialogWindow& form) {
        enterExample(form);
        form.click(SunForm::compute_button_id);
        form.type(SunForm::altitude_id, L"10");
        form.pressOk();
    });
    expectPosition(EXAMPLE_AZIMUTH_DEG, 10, EXAMPLE_TOLERANCE_DEG);
    EXPECT_THAT(printed(), testing::Not(HasSubstr("universal time")));
}

TEST_F(SunFormTest, OffersThePlaceAndTimeThatWereGivenLast) {
    session.runCommand(L"_Sun _PlaceAndTime 39.742476 -105.1786 \"2003-10-17 12:30:30\" "
                       L"_TimeZone -6.5 _NorthAngle 20 _Enter");
    answer(L"_Sun", [](HeadlessDialogWindow& form) {
        EXPECT_EQ(form.text(SunForm::latitude_id), L"39.74");
        EXPECT_EQ(form.text(SunForm::longitude_id), L"-105.18");
        EXPECT_EQ(form.dateTime(SunForm::time_id), COleDateTime(2003, 10, 17, 12, 30, 30));
        EXPECT_EQ(form.text(SunForm::zone_id), L"-6.5");
        EXPECT_EQ(form.text(SunForm::north_angle_id), L"20");
        form.choose(SunForm::time_id, {2003, 10, 17, 13, 0, 0});
        form.pressOk();
    });
    EXPECT_DOUBLE_EQ(sun().lastPlaceAndTime()->site.latitude_deg, 39.742476);
    answer(L"_Sun", [](HeadlessDialogWindow& form) {
        EXPECT_EQ(form.dateTime(SunForm::time_id), COleDateTime(2003, 10, 17, 13, 0, 0));
    });
}

TEST_F(SunFormTest, LocationButtonBeginsWithTheFieldsAndFillsThem) {
    front_end.addLocationChoice(Place{48.13743, 11.57549});
    front_end.addLocationChoice(std::nullopt);
    answer(L"_Sun", [&](HeadlessDialogWindow& form) {
        form.type(SunForm::latitude_id, L"-33,5");
        form.type(SunForm::longitude_id, L"east");
        EXPECT_TRUE(form.click(SunForm::location_button_id));
        EXPECT_EQ(form.text(SunForm::latitude_id), L"48.14");
        EXPECT_EQ(form.text(SunForm::longitude_id), L"11.58");
        form.click(SunForm::location_button_id);
        EXPECT_EQ(form.text(SunForm::latitude_id), L"48.14");
        form.pressOk();
    });
    ASSERT_EQ(front_end.locationQuestions().size(), 2U);
    EXPECT_EQ(front_end.locationQuestions()[0].start.latitude_deg, -33.5);
    EXPECT_EQ(front_end.locationQuestions()[0].start.longitude_deg, 0);
    EXPECT_DOUBLE_EQ(sun().lastPlaceAndTime()->site.latitude_deg, 48.13743);
    EXPECT_DOUBLE_EQ(sun().lastPlaceAndTime()->site.longitude_deg, 11.57549);
}

TEST_F(SunFormTest, RefusesWhatIsOutOfRange) {
    const struct {
        int control;
        const wchar_t* text;
        const wchar_t* why;
    } refused[] = {
        {SunForm::latitude_id, L"90.01", L"Enter a number between -90 and 90"},
        {SunForm::longitude_id, L"-180.01", L"Enter a number between -180 and 180"},
        {SunForm::zone_id, L"24.5", L"Enter a number between -24 and 24"},
        {SunForm::zone_id, L"UTC", L"Enter a number"},
        {SunForm::north_angle_id, L"361", L"Enter a number between -360 and 360"},
        {SunForm::azimuth_id, L"-361", L"Enter a number between -360 and 360"},
        {SunForm::altitude_id, L"91", L"Enter a number between -90 and 90"},
    };
    const KM_3dVector direction = sun().directionToSun();
    for (const auto& [control, text, why] : refused)
        EXPECT_EQ(refusal(L"_Sun", control, text), why) << KM_wString(text).ToUtf8();
    EXPECT_EQ(sun().directionToSun(), direction);
    EXPECT_FALSE(sun().lastPlaceAndTime());
}

TEST_F(SunFormTest, RefusesYearsForWhichNoSunIsKnown) {
    answer(L"_Sun", [](HeadlessDialogWindow& form) {
        form.choose(SunForm::date_id, {2200, 1, 2, 0, 0, 0});
        form.pressOk();
        EXPECT_TRUE(form.isOpen());
        EXPECT_EQ(form.focusedControl(), SunForm::date_id);
    });
    ASSERT_EQ(front_end.messages().size(), 1U);
    EXPECT_EQ(front_end.messages()[0].text,
              L"The sun has no known position for this place and time.");
}

} // namespace
} // namespace quarn::test
