#pragma once

#include "quarn/scripts/StudySite.h"

#include <chrono>
#include <optional>
#include <string>
#include <string_view>
#include <variant>

namespace quarn::program {

/// A day that the year's course of the sun names.
enum class SeasonDay { march_equinox, june_solstice, september_equinox, december_solstice };

/// Nothing: today.
using WantedDay = std::variant<std::monostate, std::chrono::year_month_day, SeasonDay>;

/// The day by the clocks of a place; those of the sun are days of this year.
std::chrono::year_month_day dayOf(const WantedDay& wanted, const Zone& zone);

/// A time of a day: by the clock, or so long after the sun rises or sets.
struct WantedTime {
    enum class Since { midnight, sunrise, sunset };
    Since since = Since::midnight;
    std::chrono::minutes later{0}; ///< by the clock, where that is since midnight
};

/// Reads "6:05", "sunrise", "sunrise+1h", "sunset-1h30m", "sunset+45m".
/// @return nothing for a word of any other form, or half a day and more from the sun
std::optional<WantedTime> wantedTime(std::string_view word);

/// A moment that was found, or why there is none, and what is to be told of it.
struct FoundMoment {
    std::chrono::sys_seconds time; ///< a whole minute
    std::string mistake;           ///< a sentence; empty: the moment was found
    std::string note;              ///< empty: nothing
};

/// Finds a time of day. Of two moments that clocks show alike it is the first, or for an end the
/// second.
/// @param option  that it is asked for with, for messages
FoundMoment findTime(const StudySite& site, std::chrono::year_month_day day,
                     const WantedTime& wanted, const std::string& option, bool is_end);

/// The first and the last moment of a day at which the sun's centre is above the horizon, of those
/// that are a whole number of steps after midnight; where none is, when the sun is highest.
struct Daylight {
    std::chrono::sys_seconds first;
    std::chrono::sys_seconds last;
    std::string mistake; ///< there is none; empty: there is
    std::string note;    ///< empty: nothing
};
Daylight daylightOf(const StudySite& site, std::chrono::year_month_day day,
                    std::chrono::minutes step);

} // namespace quarn::program
