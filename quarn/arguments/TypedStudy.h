#pragma once

#include "host/cities/Cities.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/scripts/StudyDay.h"
#include "quarn/scripts/SunStudyRequest.h"

#include <chrono>
#include <optional>
#include <string>

namespace quarn::program {

inline constexpr int FIRST_YEAR_OF_STUDY = 1800;
inline constexpr int LAST_YEAR_OF_DAY = 2199;    // as the host's sun takes them
inline constexpr int LAST_YEAR_OF_SEASON = 2100; // as the command of a seasonal study takes them

/// A study as it is typed: what it is made of is put together when all words are read.
struct TypedStudy {
    SunStudyRequest request{};
    const City* city = nullptr;
    std::optional<double> latitude_deg;
    std::optional<double> longitude_deg;
    std::optional<double> north_deg;
    std::string zone; ///< empty: that of the place
    WantedDay day;    ///< of a day's study
    std::optional<WantedTime> first_time;
    std::optional<WantedTime> last_time;
    std::optional<std::chrono::year_month_day> first_date; ///< of a season
    std::optional<std::chrono::year_month_day> last_date;
    WantedTime noon{WantedTime::Since::midnight, std::chrono::hours(12)};
    ScriptUse use;
};

/// Settles the place that the study is of; the request's recording must be settled.
/// @return why there is none
std::optional<std::string> settleSite(TypedStudy& typed);

/// Settles the clocks, the span and the number of frames; the place must be settled.
/// @return what is wrong with them
std::optional<std::string> settleTimes(TypedStudy& typed);

} // namespace quarn::program
