#pragma once

#include "ground/Result.h"
#include "host/almanac/DayTimes.h"
#include "host/almanac/StudyCourse.h"
#include "host/almanac/WantedDay.h"

#include <chrono>
#include <optional>

namespace quarn {

/// The last year that the command of a seasonal study takes.
inline constexpr int LAST_SEASON_YEAR = 2100;

/// A day as a person wants to see it.
struct WantedCourse {
    WantedDay day;
    std::optional<WantedTime> first; ///< nothing: the first step with the sun above the horizon
    std::optional<WantedTime> last;  ///< nothing: the last such step
};

/// Finds the moments of a study of one day.
/// @param step_minutes  between frames, from 1
/// @return an error, a sentence, for a date or time that is not there, an end before the beginning,
///         a sun that does not rise, and frames outside the years of the sun
QNCORE_API Result<StudyCourse> courseOfDay(const CivilSite& site, const WantedCourse& wanted,
                                           int step_minutes);

/// Finds the moments of a seasonal study, each at the same time of the place's standard clock.
///
/// @param first, last  dates; without one of them it is the year that begins or ends with the
/// other,
///                     without both this year
/// @param time         since midnight
/// @param step_days    between frames, from 1
/// @return an error, a sentence, for an end before the beginning, and frames outside the years that
///         the set-up command takes
QNCORE_API Result<StudyCourse> courseOfSeason(const CivilSite& site,
                                              std::optional<std::chrono::year_month_day> first,
                                              std::optional<std::chrono::year_month_day> last,
                                              std::chrono::minutes time, int step_days);

} // namespace quarn
