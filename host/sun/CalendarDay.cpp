#include "host/sun/CalendarDay.h"

namespace quarn {

std::optional<std::chrono::sys_days> calendarDay(int year, int month, int day) {
    // The types of the calendar wrap numbers that they cannot hold, and so could make them valid.
    if (year < 1 || year > 9999 || month < 1 || month > 12 || day < 1 || day > 31)
        return std::nullopt;
    const std::chrono::year_month_day date{std::chrono::year(year),
                                           std::chrono::month(static_cast<unsigned>(month)),
                                           std::chrono::day(static_cast<unsigned>(day))};
    if (!date.ok())
        return std::nullopt;
    return std::chrono::sys_days(date);
}

} // namespace quarn
