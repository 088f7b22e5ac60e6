#include "host/cities/Cities.h"
#include "host/cities/CityAliases.h"
#include "host/cities/CitySpelling.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <set>
#include <string>

namespace {

using namespace quarn;

std::string fullName(const City& city) {
    return std::string(city.name) + ", " + std::string(city.country);
}

std::vector<std::string> suggestionsFor(std::string_view name) {
    std::vector<std::string> names;
    for (const City* city : citiesLike(name))
        names.push_back(fullName(*city));
    return names;
}

bool contains(const std::vector<std::string>& names, const std::string& name) {
    return std::ranges::find(names, name) != names.end();
}

TEST(Cities, AreSortedByNameThenCountryAndNoneIsThereTwice) {
    const auto key = [](const City& city) {
        return comparedName(city.name) + ',' + comparedName(city.country);
    };
    ASSERT_GE(cities().size(), 120U);
    for (std::size_t index = 1; index < cities().size(); ++index)
        EXPECT_LT(key(cities()[index - 1]), key(cities()[index])) << cities()[index].name;
}

TEST(Cities, NoTwoAreAtTheSamePlace) {
    std::set<std::pair<double, double>> places;
    for (const City& city : cities())
        EXPECT_TRUE(places.emplace(city.latitude_deg, city.longitude_deg).second) << city.name;
}

TEST(Cities, LieOnTheEarthToAHundredthOfADegree) {
    for (const City& city : cities()) {
        EXPECT_LE(std::abs(city.latitude_deg), 90) << city.name;
        EXPECT_LE(std::abs(city.longitude_deg), 180) << city.name;
        for (const double angle : {city.latitude_deg, city.longitude_deg})
            EXPECT_NEAR(angle * 100, std::round(angle * 100), 1e-6) << city.name;
    }
}

// Degrees and minutes (latitude ddmm, longitude dddmm) from zone.tab of the IANA time zone
// database, which is in the public domain. Its middle of a city differs from ours by a few
// kilometres.
TEST(Cities, LieWhereTheTimeZoneDatabasePutsThem) {
    const struct {
        const char* name;
        int latitude_ddmm, longitude_dddmm;
    } places[] = {
        {"Kabul", 3431, 6912},
        {"Ushuaia", -5448, -6818},
        {"Vienna", 4813, 1620},
        {"Melbourne", -3749, 14458},
        {"Sydney", -3352, 15113},
        {"Perth", -3157, 11551},
        {"Hobart", -4253, 14719},
        {"Dhaka", 2343, 9025},
        {"Sofia", 4241, 2319},
        {"La Paz", -1630, -6809},
        {"São Paulo", -2332, -4637},
        {"Recife", -803, -3454},
        {"Toronto", 4339, -7923},
        {"Vancouver", 4916, -12307},
        {"Zürich", 4723, 832},
        {"Abidjan", 519, -402},
        {"Punta Arenas", -5309, -7055},
        {"Shanghai", 3114, 12128},
        {"Bogotá", 436, -7405},
        {"Havana", 2308, -8222},
        {"Berlin", 5230, 1322},
        {"Copenhagen", 5540, 1235},
        {"Cairo", 3003, 3115},
        {"Madrid", 4024, -341},
        {"Addis Ababa", 902, 3842},
        {"Helsinki", 6010, 2458},
        {"Paris", 4852, 220},
        {"Nuuk", 6411, -5144},
        {"Jakarta", -610, 10648},
        {"Dublin", 5320, -615},
        {"Reykjavík", 6409, -2151},
        {"Rome", 4154, 1229},
        {"Tokyo", 353916, 1394441},
        {"Nairobi", -117, 3649},
        {"Seoul", 3733, 12658},
        {"Beirut", 3353, 3530},
        {"Antananarivo", -1855, 4731},
        {"Mexico City", 1924, -9909},
        {"Lagos", 627, 324},
        {"Oslo", 5955, 1045},
        {"Auckland", -3652, 17446},
        {"Lima", -1203, -7703},
        {"Manila", 143512, 1205804},
        {"Lisbon", 3843, -908},
        {"Moscow", 554521, 373704},
        {"Vladivostok", 4310, 13156},
        {"Longyearbyen", 7800, 1600},
        {"Bangkok", 1345, 10031},
        {"New York", 404251, -740023},
        {"Chicago", 415100, -873900},
        {"Denver", 394421, -1045903},
        {"Los Angeles", 340308, -1181434},
        {"Anchorage", 611305, -1495401},
        {"Honolulu", 211825, -1575130},
        {"Montevideo", -345433, -561245},
        {"Johannesburg", -2615, 2800},
        {"Singapore", 117, 10351},
        {"Stanley", -5142, -5751},
    };
    const auto degrees = [](int value, bool has_seconds) {
        const int size = std::abs(value);
        const double angle = has_seconds
                                 ? size / 10000 + size / 100 % 100 / 60.0 + size % 100 / 3600.0
                                 : size / 100 + size % 100 / 60.0;
        return value < 0 ? -angle : angle;
    };
    for (const auto& [name, latitude, longitude] : places) {
        SCOPED_TRACE(name);
        const City* city = findCity(name);
        ASSERT_NE(city, nullptr);
        const bool has_seconds = std::abs(latitude) >= 10000;
        const double expected = degrees(latitude, has_seconds);
        const double east = city->longitude_deg - degrees(longitude, has_seconds);
        EXPECT_NEAR(city->latitude_deg, expected, 0.23);
        EXPECT_NEAR(east * std::cos(expected * 3.14159265 / 180), 0, 0.23);
    }
}

// A rule of geography, independent of any table: these countries lie in one hemisphere of latitude
// and one of longitude.
TEST(Cities, LieInTheHemispheresOfTheirCountry) {
    const struct {
        const char* country;
        int north, east;
    } hemispheres[] = {
        {"Argentina", -1, -1}, {"Australia", -1, 1},     {"Austria", 1, 1},
        {"Bolivia", -1, -1},   {"Canada", 1, -1},        {"Chile", -1, -1},
        {"China", 1, 1},       {"Costa Rica", 1, -1},    {"Cuba", 1, -1},
        {"Egypt", 1, 1},       {"Finland", 1, 1},        {"Germany", 1, 1},
        {"Greenland", 1, -1},  {"Iceland", 1, -1},       {"India", 1, 1},
        {"Ireland", 1, -1},    {"Italy", 1, 1},          {"Japan", 1, 1},
        {"Madagascar", -1, 1}, {"Mexico", 1, -1},        {"Morocco", 1, -1},
        {"Mozambique", -1, 1}, {"New Zealand", -1, 1},   {"Norway", 1, 1},
        {"Peru", -1, -1},      {"Poland", 1, 1},         {"Portugal", 1, -1},
        {"Senegal", 1, -1},    {"South Africa", -1, 1},  {"Sweden", 1, 1},
        {"Turkey", 1, 1},      {"United States", 1, -1}, {"Uruguay", -1, -1},
        {"Venezuela", 1, -1},  {"Vietnam", 1, 1},        {"Zimbabwe", -1, 1},
    };
    for (const auto& [country, north, east] : hemispheres) {
        int found = 0;
        for (const City& city : cities()) {
            if (city.country != country)
                continue;
            ++found;
            EXPECT_GT(city.latitude_deg * north, 0) << city.name;
            EXPECT_GT(city.longitude_deg * east, 0) << city.name;
        }
        EXPECT_GT(found, 0) << country;
    }
}

TEST(Cities, EachIsFoundByItsNameAndCountryAndByItsNameAloneUnlessSeveralHaveIt) {
    for (const City& city : cities()) {
        EXPECT_EQ(findCity(fullName(city)), &city) << city.name;
        EXPECT_EQ(findCity(comparedName(city.name) + "," + comparedName(city.country)), &city)
            << city.name;
        const auto has_name = [&](const City& other) {
            return comparedName(other.name) == comparedName(city.name);
        };
        const bool is_only = std::ranges::count_if(cities(), has_name) == 1;
        EXPECT_EQ(findCity(city.name), is_only ? &city : nullptr) << city.name;
    }
}

TEST(Cities, AreFoundInAnySpellingOfCaseAccentsBlanksAndMarks) {
    const char* const spellings[][2] = {
        {"São Paulo", "sao paulo"},
        {"São Paulo", "SÃO PAULO"},
        {"São Paulo", "Sao-Paulo"},
        {"São Paulo", "Sa\u0303o Paulo"},
        {"Tromsø", "Tromso"},
        {"Zürich", "ZURICH"},
        {"Reykjavík", "  reykjavik "},
        {"Kraków", "Krakow"},
        {"Wrocław", "wroclaw"},
        {"Chișinău", "Chisinau"},
        {"St. John's", "St Johns"},
        {"Nuku'alofa", "Nuku\u2019alofa"},
        {"Port-au-Prince", "portauprince"},
        {"N'Djamena", "Ndjamena"},
        {"New York", "new_york"},
        {"Asunción", "ASUNCIÓN"},
    };
    for (const auto& [name, spelling] : spellings) {
        const City* city = findCity(spelling);
        ASSERT_NE(city, nullptr) << spelling;
        EXPECT_EQ(city->name, name);
    }
}

TEST(Cities, AreFoundByLocalAndFormerNames) {
    for (const CityAlias& other : cityAliases()) {
        const City* city = findCity(other.alias);
        ASSERT_NE(city, nullptr) << other.alias;
        EXPECT_EQ(city, findCity(other.name)) << other.alias;
    }
    EXPECT_EQ(findCity("münchen")->name, "Munich");
    EXPECT_EQ(findCity("Koln, Germany")->name, "Cologne");
    EXPECT_EQ(findCity("東京")->name, "Tokyo");
    EXPECT_EQ(findCity("Washington DC")->name, "Washington");
    EXPECT_EQ(findCity("Köln, France"), nullptr);
}

TEST(Cities, ACountryDecidesBetweenCitiesOfOneName) {
    EXPECT_EQ(findCity("Birmingham"), nullptr);
    EXPECT_EQ(findCity("Birmingham, United Kingdom")->latitude_deg, 52.48);
    EXPECT_EQ(findCity("birmingham,UK")->latitude_deg, 52.48);
    EXPECT_EQ(findCity("Birmingham, USA")->latitude_deg, 33.52);
    EXPECT_EQ(findCity("Birmingham, France"), nullptr);
    EXPECT_EQ(findCity("San Jose, Costa Rica")->latitude_deg, 9.93);
    EXPECT_EQ(findCity("London, Canada"), nullptr);
    EXPECT_EQ(findCity("Paris, France")->country, "France");
}

TEST(Cities, OtherNamesOfCountriesLeadToCountriesOfTheTable) {
    for (const CityAlias& other : countryAliases()) {
        EXPECT_TRUE(std::ranges::any_of(cities(), [&](const City& city) {
            return city.country == other.name;
        })) << other.alias;
    }
}

TEST(Cities, WhatIsNoCityIsNotFound) {
    for (const char* name : {"", " ", ",", ", ", ",France", "Atlantis", "-", "\xC3", "\xFF\xFE",
                             "London Paris", "51.5"})
        EXPECT_EQ(findCity(name), nullptr) << name;
}

TEST(Cities, AMisspeltNameSuggestsTheCityThatWasMeant) {
    EXPECT_EQ(suggestionsFor("Lodnon").front(), "London, United Kingdom");
    EXPECT_EQ(suggestionsFor("Londn").front(), "London, United Kingdom");
    EXPECT_EQ(suggestionsFor("Reikjavik").front(), "Reykjavík, Iceland");
    EXPECT_EQ(suggestionsFor("Copenhaguen").front(), "Copenhagen, Denmark");
    EXPECT_EQ(suggestionsFor("Mucnhen").front(), "Munich, Germany");
    EXPECT_EQ(suggestionsFor("Lodnon, United Kingdom").front(), "London, United Kingdom");
}

TEST(Cities, TheBeginningOfANameSuggestsAllThatBeginLikeIt) {
    EXPECT_EQ(suggestionsFor("new"),
              (std::vector<std::string>{"New Delhi, India", "New Orleans, United States",
                                        "New York, United States"}));
    EXPECT_TRUE(contains(suggestionsFor("Santia"), "Santiago, Chile"));
    EXPECT_LE(suggestionsFor("s").size(), 5U);
}

TEST(Cities, ANameThatSeveralHaveSuggestsThemFirst) {
    const auto names = suggestionsFor("Birmingham");
    ASSERT_GE(names.size(), 2U);
    EXPECT_EQ(names[0], "Birmingham, United Kingdom");
    EXPECT_EQ(names[1], "Birmingham, United States");
    EXPECT_EQ(suggestionsFor("London, Canada").front(), "London, United Kingdom");
}

TEST(Cities, NothingIsSuggestedForWhatIsLikeNoName) {
    EXPECT_TRUE(suggestionsFor("").empty());
    EXPECT_TRUE(suggestionsFor("Xqzzwvk").empty());
    EXPECT_TRUE(suggestionsFor(", France").empty());
}

TEST(Cities, ANameThatIsNotTakenIsToldWithThoseThatMayBeMeant) {
    EXPECT_EQ(whyNoCity("Lodnon"),
              "There is no city \"Lodnon\" in the list. Is it one of these: London, United "
              "Kingdom?");
    EXPECT_EQ(whyNoCity("Birmingham"),
              "Several cities are called \"Birmingham\": Birmingham, United Kingdom; Birmingham, "
              "United States. Give the country too.");
    EXPECT_EQ(whyNoCity("Xqzzwvk"), "There is no city \"Xqzzwvk\" in the list.");
}

TEST(Cities, NameAndCountryTogetherFindEveryCity) {
    for (const City& city : cities())
        EXPECT_EQ(findCity(nameWithCountry(city)), &city) << city.name;
}

// By hand: one swap; one change and one letter more; all letters put in.
TEST(CitySpelling, CountsTheLettersThatDiffer) {
    EXPECT_EQ(lettersApart("lodnon", "london"), 1);
    EXPECT_EQ(lettersApart("london", "londxons"), 2);
    EXPECT_EQ(lettersApart("", "abc"), 3);
    EXPECT_EQ(lettersApart("abc", ""), 3);
    EXPECT_EQ(lettersApart("kitten", "sitting"), 3);
    EXPECT_EQ(lettersApart("same", "same"), 0);
}

TEST(CitySpelling, KeepsLettersAndDigitsAlone) {
    EXPECT_EQ(comparedName("Straßburg"), "strassburg");
    EXPECT_EQ(comparedName("Ærø Ødense Œuf"), "aeroodenseoeuf");
    EXPECT_EQ(comparedName("Łódź İzmir Ğ Ş Đ"), "lodzizmirgsd");
    EXPECT_EQ(comparedName("A-b c_1’"), "abc1");
    EXPECT_EQ(comparedName("東京"), "東京");
}

} // namespace
