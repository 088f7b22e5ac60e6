#pragma once

#include "host/clock/ZoneRules.h"

#include <optional>
#include <string_view>

namespace quarn {

/// The rule at the end of a zone file, which holds for all times after its last listed change:
/// "CET-1CEST,M3.5.0,M10.5.0/3" (A. Olson, P. Eggert, K. Murchison, "The Time Zone Information
/// Format (TZif)", RFC 9636, section 3.3: the text of the variable TZ in POSIX.1, chapter 8.3, with
/// hours from -167 to 167).
class FooterRule {
public:
    /// @return nothing for a text that is no such rule
    static std::optional<FooterRule> read(std::string_view text);

    ClockPeriod periodAt(std::chrono::sys_seconds utc) const;

private:
    /// A day of every year, and a time of that day by the clock that is about to change.
    struct Change {
        enum class Day { month_week, from_zero, without_leap_day };
        Day counted = Day::month_week;
        int number = 0; ///< of the day in the year, for the last two
        int month = 1;
        int week = 1;    ///< 5: the last
        int weekday = 0; ///< 0: Sunday
        std::chrono::seconds time{7200};

        /// As a clock shows it, counted as if that were UTC.
        std::chrono::sys_seconds in(std::chrono::year year) const;
    };
    class Reader;

    std::chrono::seconds m_standard{0};
    std::chrono::seconds m_saving{0}; ///< offset during daylight saving
    std::string m_standard_name;
    std::string m_saving_name; ///< empty: clocks are never changed
    Change m_start;
    Change m_end;
};

} // namespace quarn
