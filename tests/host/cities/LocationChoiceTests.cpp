#include "host/cities/LocationChoice.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <random>
#include <string>

namespace {

using namespace quarn;
using Flaw = LocationChoice::Flaw;

const Place MUNICH = {48.14, 11.58};

std::vector<std::string> namesOf(const LocationChoice& choice) {
    std::vector<std::string> names;
    for (const City* city : choice.listedCities())
        names.emplace_back(city->name);
    return names;
}

bool lists(const LocationChoice& choice, const std::string& name) {
    return std::ranges::count(namesOf(choice), name) > 0;
}

TEST(LocationChoice, BeginsWithThePlaceInItsFieldsAndAllCities) {
    const LocationChoice choice({-33.87, 151.2});
    EXPECT_EQ(choice.latitudeText(), L"-33.87");
    EXPECT_EQ(choice.longitudeText(), L"151.2");
    EXPECT_TRUE(choice.isValid());
    EXPECT_EQ(choice.listedCities().size(), cities().size());
}

TEST(LocationChoice, RefusesALatitudeAbove90AndTakes90ItselfAndItsOpposite) {
    LocationChoice choice(MUNICH);
    choice.typeLatitude(L"90.5");
    EXPECT_EQ(choice.latitudeFlaw(), Flaw::out_of_range);
    EXPECT_EQ(choice.longitudeFlaw(), Flaw::none);
    EXPECT_FALSE(choice.isValid());
    EXPECT_FALSE(choice.place());
    for (const wchar_t* pole : {L"90", L"-90", L"90.0"}) {
        choice.typeLatitude(pole);
        EXPECT_TRUE(choice.isValid()) << choice.latitudeText().size();
    }
}

TEST(LocationChoice, RefusesALongitudeBeyond180) {
    LocationChoice choice(MUNICH);
    choice.typeLongitude(L"-180.01");
    EXPECT_EQ(choice.longitudeFlaw(), Flaw::out_of_range);
    choice.typeLongitude(L"-180");
    EXPECT_EQ(choice.longitudeFlaw(), Flaw::none);
    EXPECT_DOUBLE_EQ(choice.place()->longitude_deg, -180);
}

TEST(LocationChoice, TellsATextThatIsNoNumber) {
    LocationChoice choice(MUNICH);
    for (const wchar_t* text : {L"", L"north", L"48.1.2", L"48 14", L"1e1", L"inf", L"nan", L"-",
                                L"4８", L"--4", L"+-4", L"0x10"}) {
        choice.typeLatitude(text);
        EXPECT_EQ(choice.latitudeFlaw(), Flaw::no_number) << KM_wString(text).ToUtf8();
    }
}

TEST(LocationChoice, ReadsAnglesAsPeopleWriteThem) {
    const struct {
        const wchar_t* text;
        double latitude_deg;
    } examples[] = {{L"48.14", 48.14},
                    {L" 48,14 ", 48.14},
                    {L"48.14\u00B0", 48.14},
                    {L"33.87 S", -33.87},
                    {L"33.87\u00B0 s", -33.87},
                    {L"48.14N", 48.14},
                    {L"\u221233.87", -33.87},
                    {L"+5", 5},
                    {L".5", 0.5}};
    for (const auto& example : examples) {
        LocationChoice choice({});
        choice.typeLatitude(example.text);
        ASSERT_TRUE(choice.isValid()) << KM_wString(example.text).ToUtf8();
        EXPECT_DOUBLE_EQ(choice.place()->latitude_deg, example.latitude_deg);
    }
    LocationChoice choice({});
    choice.typeLongitude(L"70.67 W");
    EXPECT_DOUBLE_EQ(choice.place()->longitude_deg, -70.67);
    choice.typeLongitude(L"70.67 S");
    EXPECT_EQ(choice.longitudeFlaw(), Flaw::no_number);
}

TEST(LocationChoice, KeepsAPlaceAsItIsWhileItsShownTextStands) {
    LocationChoice choice({12.3456789, -65.4321987});
    EXPECT_EQ(choice.latitudeText(), L"12.3457");
    choice.typeLatitude(L"12.3457");
    EXPECT_DOUBLE_EQ(choice.place()->latitude_deg, 12.3456789);
    EXPECT_DOUBLE_EQ(choice.place()->longitude_deg, -65.4321987);
}

TEST(LocationChoice, ShowsAnglesWithoutZerosThatSayNothing) {
    EXPECT_EQ(textFromAngle(0.0), L"0");
    EXPECT_EQ(textFromAngle(-0.00001), L"0");
    EXPECT_EQ(textFromAngle(100.0), L"100");
    EXPECT_EQ(textFromAngle(-33.8650), L"-33.865");
}

TEST(LocationChoice, FillsTheFieldsFromACity) {
    LocationChoice choice({});
    const City* const sydney = findCity("Sydney");
    ASSERT_NE(sydney, nullptr);
    choice.typeLatitude(L"nonsense");
    choice.choose(*sydney);
    EXPECT_TRUE(choice.isValid());
    EXPECT_DOUBLE_EQ(choice.place()->latitude_deg, sydney->latitude_deg);
    EXPECT_EQ(choice.cityHere(), sydney);
    choice.typeLatitude(L"-30");
    EXPECT_EQ(choice.cityHere(), nullptr);
}

TEST(LocationChoice, ListsCitiesByTheBeginningOfTheirNames) {
    LocationChoice choice({});
    choice.search(L"mun");
    EXPECT_TRUE(lists(choice, "Munich"));
    EXPECT_FALSE(lists(choice, "London"));
    choice.search(L"SAO P");
    EXPECT_EQ(namesOf(choice), std::vector<std::string>{"São Paulo"});
}

TEST(LocationChoice, ListsCitiesByOtherNamesByWordsAndByCountry) {
    LocationChoice choice({});
    choice.search(L"Münch");
    EXPECT_TRUE(lists(choice, "Munich"));
    choice.search(L"東");
    EXPECT_TRUE(lists(choice, "Tokyo"));
    choice.search(L"york");
    EXPECT_TRUE(lists(choice, "New York"));
    choice.search(L"german");
    EXPECT_TRUE(lists(choice, "Berlin"));
    EXPECT_TRUE(lists(choice, "Munich"));
    EXPECT_FALSE(lists(choice, "Vienna"));
}

TEST(LocationChoice, ListsWhatIsFoundByItsNameBeforeWhatIsFoundByItsCountry) {
    LocationChoice choice({});
    choice.search(L"mexico");
    const auto names = namesOf(choice);
    ASSERT_GE(names.size(), 2U);
    EXPECT_EQ(names.front(), "Mexico City");
}

TEST(LocationChoice, ListsTheCitiesOfACountryBehindAComma) {
    LocationChoice choice({});
    choice.search(L"birmingham, usa");
    ASSERT_EQ(choice.listedCities().size(), 1U);
    EXPECT_EQ(choice.listedCities()[0]->country, "United States");
    choice.search(L", norw");
    ASSERT_FALSE(choice.listedCities().empty());
    for (const City* city : choice.listedCities())
        EXPECT_EQ(city->country, "Norway");
}

TEST(LocationChoice, ListsCitiesOfLikeNamesWhenNoneBeginsSo) {
    LocationChoice choice({});
    choice.search(L"Lodnon");
    EXPECT_TRUE(lists(choice, "London"));
    choice.search(L"qqqqqqqqqqqq");
    EXPECT_TRUE(choice.listedCities().empty());
    choice.search(L"  ");
    EXPECT_EQ(choice.listedCities().size(), cities().size());
}

TEST(LocationChoice, KnowsTheNearestCityAlsoOverThe180thMeridian) {
    LocationChoice choice({48.3, 11.7});
    EXPECT_EQ(choice.nearestCity()->name, "Munich");
    // 0.5 degrees east of the meridian Fiji lies 2.1 degrees to the west, and Tonga 4.3 to the
    // east.
    choice.choose(Place{-18.14, -179.5});
    EXPECT_EQ(choice.nearestCity()->name, "Suva");
    choice.typeLongitude(L"x");
    EXPECT_EQ(choice.nearestCity(), nullptr);
}

TEST(WorldMap, PutsTheCornersAndTheMiddleWhereTheyBelong) {
    const WorldMapSize size = {720, 360};
    const auto corner = worldMapPoint({90, -180}, size);
    EXPECT_DOUBLE_EQ(corner.x, 0);
    EXPECT_DOUBLE_EQ(corner.y, 0);
    const auto middle = worldMapPoint({0, 0}, size);
    EXPECT_DOUBLE_EQ(middle.x, 360);
    EXPECT_DOUBLE_EQ(middle.y, 180);
    const auto sydney = worldMapPoint({-33.87, 151.21}, size);
    EXPECT_NEAR(sydney.x, 662.42, 1e-9); // (151.21 + 180) * 2
    EXPECT_NEAR(sydney.y, 247.74, 1e-9); // (90 + 33.87) * 2
}

TEST(WorldMap, GivesBackTheSamePlaceWhateverItsSize) {
    std::mt19937 random(7);
    std::uniform_real_distribution<double> latitudes(-90, 90);
    std::uniform_real_distribution<double> longitudes(-180, 180);
    std::uniform_real_distribution<double> lengths(1, 3000);
    for (int round = 0; round < 200; ++round) {
        const Place place = {latitudes(random), longitudes(random)};
        const WorldMapSize size = {lengths(random), lengths(random)};
        const Place back = placeOnWorldMap(worldMapPoint(place, size), size);
        EXPECT_NEAR(back.latitude_deg, place.latitude_deg, 1e-9);
        EXPECT_NEAR(back.longitude_deg, place.longitude_deg, 1e-9);
    }
}

TEST(WorldMap, TakesAPositionBesideThePictureForTheNearestOnItsEdge) {
    const Place beyond = placeOnWorldMap({-5, 1000}, {720, 360});
    EXPECT_DOUBLE_EQ(beyond.latitude_deg, -90);
    EXPECT_DOUBLE_EQ(beyond.longitude_deg, -180);
    const Place nowhere = placeOnWorldMap({5, 5}, {0, 360});
    EXPECT_DOUBLE_EQ(nowhere.latitude_deg, 0);
    EXPECT_DOUBLE_EQ(nowhere.longitude_deg, 0);
}

} // namespace
