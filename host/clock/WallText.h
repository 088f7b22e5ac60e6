#pragma once

#include "host/clock/Zone.h"

#include <chrono>
#include <string>

// How times are told. Clocks whose distance from UTC is no whole minute, as those of the sun, are
// told to the nearest one.
namespace quarn {

/// "2026-06-21"
QNCORE_API std::string dateText(std::chrono::year_month_day day);
QNCORE_API std::string dateText(const WallTime& wall);
/// "14:30"
QNCORE_API std::string timeText(const WallTime& wall);
/// "14:30 CEST"
QNCORE_API std::string timeWithZone(const WallTime& wall);
/// "2026-06-21 14:30 CEST"
QNCORE_API std::string dateAndTime(const WallTime& wall);
/// "2026-06-21T14:30:00"
QNCORE_API std::string isoText(const WallTime& wall);
/// "2026-06-21T14:30:05+02:00": to the second, for programs
QNCORE_API std::string isoTextWithOffset(const WallTime& wall);
/// "UTC+2", "UTC+5:30"
QNCORE_API std::string offsetText(const WallTime& wall);

} // namespace quarn
