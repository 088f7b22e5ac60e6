#include "host/sunpath/SunPaths.h"

#include "host/sun/Seasons.h"

#include <algorithm>
#include <cmath>

namespace quarn {
namespace {

using std::chrono::days;
using std::chrono::minutes;
using std::chrono::sys_seconds;

/// The sun goes at most a degree and a half in this time: a straight line leaves its way by a
/// hundredth of a degree at the most.
constexpr minutes STEP_OF_DAY(6);

/// In four days a loop bends as little.
constexpr days STEP_OF_YEAR(4);

/// Where the line between two positions on either side of the horizon crosses it.
SunPosition atHorizon(const SunPosition& one, const SunPosition& other) {
    const double share = one.altitude_deg / (one.altitude_deg - other.altitude_deg);
    const double turn = std::remainder(other.azimuth_deg - one.azimuth_deg, 360);
    return {std::fmod(one.azimuth_deg + share * turn + 360, 360), 0};
}

/// The pieces above the horizon of a way with these steps, its end included.
SunPath aboveHorizon(const SunSite& site, sys_seconds from, sys_seconds to,
                     std::chrono::seconds step) {
    SunPath path;
    SunPosition last{};
    for (sys_seconds time = from;; time = std::min(time + step, to)) {
        const SunPosition sun = sunPosition(site, time);
        const bool is_first = time == from;
        const bool was_up = !is_first && last.altitude_deg >= 0;
        const bool is_up = sun.altitude_deg >= 0;
        if (is_up && !was_up)
            path.emplace_back();
        if (!is_first && is_up != was_up)
            path.back().push_back(atHorizon(last, sun));
        if (is_up)
            path.back().push_back(sun);
        last = sun;
        if (time == to)
            return path;
    }
}

/// The time of day nearest an instant.
sys_seconds withHour(sys_seconds near, const StandardClock& clock, int hour) {
    const auto midnight = std::chrono::floor<days>(near + clock.ahead);
    return midnight + std::chrono::hours(hour) - clock.ahead;
}

} // namespace

SunPath pathOfDay(const SunSite& site, const StandardClock& clock, std::chrono::month_day day) {
    const sys_seconds midnight = clock.at(day, minutes(0));
    return aboveHorizon(site, midnight, midnight + days(1), STEP_OF_DAY);
}

SunLoop loopOfHour(const SunSite& site, const StandardClock& clock, int hour) {
    const Seasons seasons = seasonsOf(clock.year);
    const sys_seconds summer = withHour(seasons.june_solstice, clock, hour);
    const sys_seconds winter = withHour(seasons.december_solstice, clock, hour);
    // A year before the solstice of December: the loop closes but for the quarter of a day that a
    // year is longer than 365.
    return {aboveHorizon(site, winter - days(365), summer, STEP_OF_YEAR),
            aboveHorizon(site, summer, winter, STEP_OF_YEAR)};
}

} // namespace quarn
