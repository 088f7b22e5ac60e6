#pragma once

#include "sdk/qncore/QnExport.h"

#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

/// A city of the world, to choose a place for the sun by its name. Names are English where English
/// has one of its own ("Munich"), else the city's own with its accents ("São Paulo"), in UTF-8.
struct City {
    std::string_view name;
    std::string_view country; ///< in English
    double latitude_deg;      ///< of the city's middle, north positive, WGS 84, to 0.01 degrees
    double longitude_deg;     ///< east positive, -180 to 180, to 0.01 degrees
    std::string_view zone;    ///< of the IANA time zone database: "Europe/Berlin"
};

/// All cities that are known by name, some 350 on every inhabited continent: the capitals, large
/// cities, and places near the ends of the inhabited earth. Sorted by name, as if the accents,
/// blanks and marks were not there; cities of one name by country. Valid for ever.
QNCORE_API std::span<const City> cities();

/// Finds a city by its name. Case, accents, blanks, hyphens and other marks make no difference:
/// "sao paulo" is São Paulo. A local name finds many of them too ("München", "東京"). A country may
/// follow a comma ("Birmingham, United States", "Birmingham, USA"), and must where several cities
/// have the name.
///
/// @param name  UTF-8
/// @return valid for ever; null when no city has the name, or several have it: `citiesLike` then
///         gives the choice
QNCORE_API const City* findCity(std::string_view name);

/// Cities that somebody may have meant by a name that `findCity` does not take.
///
/// First those of exactly this name, then those whose name begins like it, then those whose name
/// differs from it by a few letters, the nearest first ("Lodnon" gives London).
///
/// @param name  UTF-8; what follows a comma is not looked at
/// @return at most five, valid for ever; none where nothing is like it
QNCORE_API std::vector<const City*> citiesLike(std::string_view name);

/// The cities that somebody may mean who has typed so much of a name.
///
/// @param typed  UTF-8: the beginning of a city's name, of another name of it, of a word of it or
///               of its country; behind a comma the beginning of its country
/// @return those found by their name, then by a word, then by the country, each in the order of
///         cities(); where there is none, as citiesLike; for an empty text all cities
QNCORE_API std::vector<const City*> citiesOf(std::string_view typed);

/// The city whose middle is nearest to a place on the earth, on a sphere.
QNCORE_API const City& nearestCity(double latitude_deg, double longitude_deg);

/// "Athens, Greece", as findCity takes it; UTF-8.
QNCORE_API std::string nameWithCountry(const City& city);

/// What to tell about a name that findCity does not take: sentences that say whether no city or
/// several have the name, and which ones may be meant; UTF-8.
QNCORE_API std::string whyNoCity(std::string_view name);

} // namespace quarn
