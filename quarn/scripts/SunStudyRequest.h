#pragma once

#include "quarn/arguments/ProgramArguments.h"
#include "quarn/scripts/RecordingRequest.h"
#include "quarn/scripts/StudySite.h"
#include "quarn/words/DateWords.h"

#include <string>
#include <variant>
#include <vector>

namespace quarn::program {

/// The sun through a day or a year: every value is checked.
struct SunStudyRequest {
    enum class Kind { one_day, seasonal };
    Kind kind;
    RecordingRequest recording; ///< its frames are counted already
    StudySite site;
    std::vector<std::string> view_lines; ///< host commands that take the camera to its place
    COleDateTime start;                  ///< of the first frame, by the clock of the site
    COleDateTime end;                    ///< no frame is later
    int step;                            ///< between frames: minutes of a day, days of a season
};

/// Checks what was typed, before anything runs.
/// @return what to record, or the first mistake
std::variant<SunStudyRequest, Outcome> checkDay(const DayOptions& options);
std::variant<SunStudyRequest, Outcome> checkSeason(const SeasonOptions& options);

} // namespace quarn::program
