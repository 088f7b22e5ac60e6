#pragma once

#include <chrono>
#include <optional>

namespace quarn {

/// A day of the Gregorian calendar, of the years 1 to 9999.
///
/// @return the day; nothing when the calendar does not have it (31 April)
std::optional<std::chrono::sys_days> calendarDay(int year, int month, int day);

} // namespace quarn
