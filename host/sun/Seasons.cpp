#include "host/sun/Seasons.h"

#include "host/sun/SunPosition.h"

#include <cmath>

namespace quarn {
namespace {

using std::chrono::sys_seconds;

/// How long the sun takes for a degree of its longitude: a tropical year of 365.2422 days.
constexpr double SECONDS_PER_DEGREE = 365.2422 * 86400 / 360;

/// The instant at which the sun reaches a longitude.
/// @param near  within some months of it
sys_seconds instantOf(double longitude_deg, sys_seconds near) {
    // The speed of the sun is even to a thirtieth: each round leaves a thirtieth of the error.
    constexpr int ROUNDS = 8;
    for (int round = 0; round < ROUNDS; ++round) {
        const double missing_deg = std::remainder(longitude_deg - sunLongitude(near), 360);
        near += std::chrono::seconds(std::llround(missing_deg * SECONDS_PER_DEGREE));
    }
    return near;
}

} // namespace

Seasons seasonsOf(int year) {
    using namespace std::chrono;
    const auto around = [&](month month) { return sys_days(std::chrono::year(year) / month / 21); };
    return {instantOf(0, around(March)), instantOf(90, around(June)),
            instantOf(180, around(September)), instantOf(270, around(December))};
}

} // namespace quarn
