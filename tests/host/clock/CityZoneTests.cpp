#include "host/cities/Cities.h"
#include "host/clock/Zone.h"
#include "host/clock/ZoneOffset.h"
#include "tests/host/clock/CLibraryClock.h"

#include <gtest/gtest.h>

#include <cmath>
#include <map>
#include <random>

namespace {

using namespace quarn;
using namespace std::chrono;

TEST(CityZones, AreInTheDatabaseAndNearTheHoursOfTheirLongitude) {
    for (const City& city : cities()) {
        const auto zone = Zone::named(city.zone);
        ASSERT_TRUE(zone.ok()) << city.name << ": " << zone.message();
        // The date line bends: Samoa and Tonga are a day ahead of their longitude.
        const double hours =
            duration<double, std::ratio<3600>>(zone.value().standardOffset(2026)).count();
        const double apart = std::remainder(hours - city.longitude_deg / 15.0, 24.0);
        EXPECT_LE(std::abs(apart), 3.5) << city.name;
    }
}

// Two hundred moments from 1800 to 2199 in each zone, by seed.
TEST(CityZones, ShowWhatTheCLibraryShows) {
    std::map<std::string_view, const City*> by_zone;
    for (const City& city : cities())
        by_zone.emplace(city.zone, &city);
    std::mt19937 random(20);
    std::uniform_int_distribution<std::int64_t> moments(-5364662400, 7258118399);
    for (const auto& [name, city] : by_zone) {
        const auto zone = Zone::named(name);
        ASSERT_TRUE(zone.ok());
        const CLibraryClock c_library{std::string(name)};
        for (int index = 0; index < 200; ++index) {
            const sys_seconds moment{seconds(moments(random))};
            const WallTime wall = zone.value().at(moment);
            const std::tm shown = c_library.at(moment);
            ASSERT_EQ(wall.offset.count(), shown.tm_gmtoff)
                << name << " " << moment.time_since_epoch().count();
            ASSERT_EQ(wall.abbreviation, letteredName(shown.tm_zone, wall.offset)) << name;
            const WallReading reading = zone.value().read(wall.local);
            ASSERT_TRUE(reading.first == moment || reading.second == moment) << name;
        }
    }
}

// From the countries' own laws, by hand.
TEST(CityZones, AreThoseThatTheirClocksFollow) {
    const std::pair<const char*, const char*> KNOWN[] = {
        {"Alice Springs", "Australia/Darwin"},
        {"Ankara", "Europe/Istanbul"},
        {"Antwerp", "Europe/Brussels"},
        {"Astana", "Asia/Almaty"},
        {"Atlanta", "America/New_York"},
        {"Austin", "America/Chicago"},
        {"Barcelona", "Europe/Madrid"},
        {"Basel", "Europe/Zurich"},
        {"Beijing", "Asia/Shanghai"},
        {"Belfast", "Europe/London"},
        {"Birmingham, United States", "America/Chicago"},
        {"Brasília", "America/Sao_Paulo"},
        {"Calgary", "America/Edmonton"},
        {"Canberra", "Australia/Sydney"},
        {"Cape Town", "Africa/Johannesburg"},
        {"Christchurch", "Pacific/Auckland"},
        {"Córdoba, Spain", "Europe/Madrid"},
        {"Dallas", "America/Chicago"},
        {"Delhi", "Asia/Kolkata"},
        {"Fairbanks", "America/Anchorage"},
        {"Frankfurt", "Europe/Berlin"},
        {"Hong Kong", "Asia/Hong_Kong"},
        {"Honolulu", "Pacific/Honolulu"},
        {"Houston", "America/Chicago"},
        {"Las Vegas", "America/Los_Angeles"},
        {"Marrakesh", "Africa/Casablanca"},
        {"Miami", "America/New_York"},
        {"Montreal", "America/Toronto"},
        {"Munich", "Europe/Berlin"},
        {"Murmansk", "Europe/Moscow"},
        {"Phoenix", "America/Phoenix"},
        {"Pristina", "Europe/Belgrade"},
        {"Puerto Williams", "America/Punta_Arenas"},
        {"Quito", "America/Guayaquil"},
        {"Salt Lake City", "America/Denver"},
        {"Seattle", "America/Los_Angeles"},
        {"Seville", "Europe/Madrid"},
        {"St. John's", "America/St_Johns"},
        {"Tel Aviv", "Asia/Jerusalem"},
        {"Utqiagvik", "America/Anchorage"},
        {"Victoria, Canada", "America/Vancouver"},
        {"Xi'an", "Asia/Shanghai"},
    };
    for (const auto& [name, zone] : KNOWN) {
        const City* const city = findCity(name);
        ASSERT_TRUE(city) << name;
        EXPECT_EQ(city->zone, zone) << name;
    }
}

TEST(NearestCity, IsFoundOverTheDateLineAndNearThePoles) {
    EXPECT_EQ(nearestCity(52.4, 13.1).name, "Berlin"); // Potsdam
    EXPECT_EQ(nearestCity(-18.1, -178.0).name, "Suva");
    EXPECT_EQ(nearestCity(89.0, -160.0).name, "Longyearbyen");
    EXPECT_EQ(nearestCity(-90.0, 0.0).name, "Puerto Williams");
}

} // namespace
