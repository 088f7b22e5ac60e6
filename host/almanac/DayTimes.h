#pragma once

#include "host/almanac/CivilSite.h"
#include "sdk/qncore/QnExport.h"

#include <chrono>
#include <optional>
#include <string>
#include <string_view>

namespace quarn {

/// A time of a day: by the clock, or so long after the sun rises or sets.
struct WantedTime {
    enum class Since { midnight, sunrise, sunset };
    Since since = Since::midnight;
    std::chrono::minutes later{0}; ///< by the clock, where that is since midnight
};

/// Reads "6:05" or "06:05", from 00:00 to 23:59. @return nothing for any other word
QNCORE_API std::optional<std::chrono::minutes> timeOfDay(std::string_view word);

/// Reads times of day, and "sunrise", "sunrise+1h", "sunset-1h30m", "sunset+45m".
/// @return nothing for a word of any other form, or half a day and more from the sun
QNCORE_API std::optional<WantedTime> wantedTime(std::string_view word);

/// "06:05", "sunset-1h30m": as wantedTime reads it.
QNCORE_API std::string wantedTimeText(const WantedTime& time);

/// A moment that was found, or why there is none, and what is to be told of it.
struct FoundMoment {
    enum class Kind {
        found,
        first_of_two,  ///< found, and clocks show the same again later
        second_of_two, ///< found, and clocks showed the same before
        no_day,        ///< none: clocks were put over the whole date
        skipped,       ///< none: clocks were put over it
        no_rise,       ///< none: the sun does not rise on that day
        no_set,        ///< none: the sun does not set on that day
    };
    Kind kind = Kind::found;
    std::chrono::sys_seconds time; ///< a whole minute
    std::string mistake;           ///< a sentence; empty: the moment was found
    std::string note;              ///< a sentence without its full stop; empty: nothing
};

/// Finds a time of day. Of two moments that clocks show alike it is the first, or for an end the
/// second.
/// @param option  that it is asked for with, for messages
QNCORE_API FoundMoment findTime(const CivilSite& site, std::chrono::year_month_day day,
                                const WantedTime& wanted, const std::string& option, bool is_end);

/// The first and the last moment of a day at which the sun's centre is above the horizon, of those
/// that are a whole number of steps after midnight; where none is, when the sun is highest.
struct Daylight {
    enum class Kind {
        light,
        polar_day, ///< light from midnight to midnight
        no_day,    ///< none: clocks were put over the whole date
        no_rise,   ///< none: the sun does not rise on that day
    };
    Kind kind = Kind::light;
    std::chrono::sys_seconds first;
    std::chrono::sys_seconds last;
    std::string mistake; ///< a sentence; empty: there is light
    std::string note;    ///< a sentence without its full stop; empty: nothing
};
QNCORE_API Daylight daylightOf(const CivilSite& site, std::chrono::year_month_day day,
                               std::chrono::minutes step);

} // namespace quarn
