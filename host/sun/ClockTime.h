#pragma once

#include "ground/Result.h"
#include "host/sun/SunPosition.h"
#include "sdk/qncore/QnDateTime.h"

#include <optional>
#include <string_view>

namespace quarn {

/// A date and time of day as the clocks of a zone show it.
struct ClockTime {
    COleDateTime time;
    int zone_minutes = 0; ///< what the clocks are ahead of universal time
};

/// What clocks of universal time show at the same moment.
COleDateTime universalTime(const ClockTime& clock);

/// Where the sun of the rendering kit stands.
/// @param clock  of the years 1800 to 2199; the zone at most 24 hours either way
/// @return nothing for a time or place out of range, and for a date that does not exist
std::optional<SunPosition> sunPositionAt(const SunSite& site, const ClockTime& clock);

/// A date as it was written, and whether a time of day was written with it; without one it is
/// midnight.
struct WrittenTime {
    COleDateTime time;
    bool has_time_of_day = false;
};

/// Reads `2026-06-21`, and with a time of day `2026-06-21 14:30` or `2026-06-21T14:30:00`.
/// @return an error for another text, for a date that the calendar does not have, a time that no
///         clock shows, and years without a sun: those outside 1800 to 2199
Result<WrittenTime> readDateTime(std::wstring_view text);

/// Reads a time of day, `14:30` or `14:30:00`. @return the date with it, or an error
Result<COleDateTime> readTimeOfDay(const COleDateTime& date, std::wstring_view text);

} // namespace quarn
