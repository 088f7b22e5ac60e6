#pragma once

#include "quarn/scripts/RecordingRequest.h"
#include "quarn/scripts/StudySite.h"
#include "quarn/scripts/StudyView.h"

#include <chrono>

namespace quarn::program {

/// The sun through a day or a year.
struct SunStudyRequest {
    enum class Kind { one_day, seasonal };
    Kind kind = Kind::one_day;
    RecordingRequest recording;
    StudySite site;
    StudyView view;
    std::chrono::sys_seconds start;   ///< of the first frame, a whole minute of UTC
    std::chrono::sys_seconds end;     ///< no frame is later; a whole minute too
    int step = 1;                     ///< between frames: minutes of a day, days of a season
    std::vector<std::string> notes{}; ///< what a person should know of how the times were found
};

} // namespace quarn::program
