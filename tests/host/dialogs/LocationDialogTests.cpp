#include "sdk/qncore/QnLocationDialog.h"

#include "tests/host/app/TestCommand.h"

#include <cmath>
#include <limits>

using quarn::Place;

namespace {

class LocationDialog : public quarn::test::HostTest {
protected:
    int choose(std::optional<Place> place) {
        front_end.addLocationChoice(place);
        return QnShowLocationDialog(L"Where?", latitude, longitude);
    }

    double latitude = 47.5;
    double longitude = 19.05;
};

constexpr double NO_NUMBER = std::numeric_limits<double>::quiet_NaN();
constexpr double NO_END = std::numeric_limits<double>::infinity();

} // namespace

TEST_F(LocationDialog, GivesThePlaceThatWasChosen) {
    EXPECT_EQ(1, choose(Place{12.3456, -65.4321}));
    EXPECT_EQ(12.3456, latitude);
    EXPECT_EQ(-65.4321, longitude);
    ASSERT_EQ(1U, front_end.locationQuestions().size());
    EXPECT_EQ(L"Where?", front_end.locationQuestions()[0].title);
    EXPECT_EQ(47.5, front_end.locationQuestions()[0].start.latitude_deg);
    EXPECT_EQ(19.05, front_end.locationQuestions()[0].start.longitude_deg);
}

TEST_F(LocationDialog, LimitsBelongToTheEarth) {
    EXPECT_EQ(1, choose(Place{-90.0, 180.0}));
    EXPECT_EQ(1, choose(Place{90.0, -180.0}));
}

TEST_F(LocationDialog, ClosedOrWithNobodyToChooseChangesNothing) {
    EXPECT_EQ(2, choose(std::nullopt));
    EXPECT_EQ(2, QnShowLocationDialog(L"Where?", latitude, longitude));
    EXPECT_EQ(47.5, latitude);
    EXPECT_EQ(19.05, longitude);
    EXPECT_EQ("", printed());
}

TEST_F(LocationDialog, PlaceThatIsNotOnTheEarthIsRefusedWithAMessage) {
    for (const Place& place :
         {Place{90.001, 0.0}, Place{-91.0, 0.0}, Place{0.0, 180.5}, Place{0.0, -181.0},
          Place{NO_NUMBER, 0.0}, Place{0.0, NO_NUMBER}, Place{NO_END, 0.0}, Place{0.0, -NO_END}}) {
        front_end.clearPrinted();
        EXPECT_EQ(2, choose(place)) << place.latitude_deg << " " << place.longitude_deg;
        EXPECT_EQ("A place has a latitude from -90 to 90 and a longitude from -180 to 180.\n",
                  printed());
    }
    EXPECT_EQ(47.5, latitude);
    EXPECT_EQ(19.05, longitude);
}

TEST_F(LocationDialog, BeginsAtZeroWhereThePlaceGivenIsNone) {
    latitude = NO_NUMBER;
    EXPECT_EQ(2, choose(std::nullopt));
    EXPECT_EQ(0.0, front_end.locationQuestions()[0].start.latitude_deg);
    EXPECT_EQ(0.0, front_end.locationQuestions()[0].start.longitude_deg);
    EXPECT_TRUE(std::isnan(latitude));
    EXPECT_EQ(2, QnShowLocationDialog(nullptr, latitude, longitude));
    EXPECT_EQ(L"", front_end.locationQuestions()[1].title);
}
