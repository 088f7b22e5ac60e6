#pragma once

#include "host/sun/SunPosition.h"

#include <chrono>
#include <vector>

namespace quarn {

/// The clock that a diagram of a year counts its hours and days by: the standard time of the place,
/// all year round.
struct StandardClock {
    int year;                   ///< of those that SunYears.h names
    std::chrono::seconds ahead; ///< of universal time

    /// @param day     of the calendar
    /// @param minute  since midnight
    std::chrono::sys_seconds at(std::chrono::month_day day, std::chrono::minutes time) const {
        return std::chrono::sys_days(std::chrono::year(year) / day.month() / day.day()) + time -
               ahead;
    }
};

/// A way of the sun above the horizon: its centre, without refraction. A way that is cut by the
/// horizon comes in pieces whose ends lie on it.
using SunPath = std::vector<std::vector<SunPosition>>;

/// The sun through a day, from midnight to midnight.
SunPath pathOfDay(const SunSite& site, const StandardClock& clock, std::chrono::month_day day);

/// The sun at one time of day through the year: a loop in two halves.
struct SunLoop {
    SunPath winter_to_summer; ///< from the solstice of December to that of June
    SunPath summer_to_winter;
};
SunLoop loopOfHour(const SunSite& site, const StandardClock& clock, int hour);

} // namespace quarn
