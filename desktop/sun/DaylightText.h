#pragma once

#include "host/clock/Zone.h"
#include "host/session/StudiedSite.h"

#include <QString>

#include <optional>

namespace quarn::desktop {

/// What the clocks of a place show when the sun rises, passes the meridian and sets on a day.
struct DaylightTimes {
    std::optional<std::chrono::sys_seconds> rise;
    std::optional<std::chrono::sys_seconds> transit;
    std::optional<std::chrono::sys_seconds> set;
    std::chrono::seconds length{0}; ///< of the day
};
DaylightTimes daylightTimes(const StudiedSite& site, const Zone& clock,
                            std::chrono::year_month_day day);

/// "Sunrise 05:58, sunset 20:06 CEST", in the user's language.
QString daylightText(const DaylightTimes& times, const Zone& clock);

} // namespace quarn::desktop
