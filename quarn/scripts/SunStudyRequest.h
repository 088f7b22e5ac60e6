#pragma once

#include "quarn/scripts/RecordingRequest.h"
#include "quarn/scripts/StudySite.h"
#include "quarn/scripts/StudyView.h"
#include "quarn/words/DateWords.h"

namespace quarn::program {

/// The sun through a day or a year.
struct SunStudyRequest {
    enum class Kind { one_day, seasonal };
    Kind kind = Kind::one_day;
    RecordingRequest recording;
    StudySite site;
    StudyView view;
    COleDateTime start; ///< of the first frame, by the clock of the site
    COleDateTime end;   ///< no frame is later
    int step = 1;       ///< between frames: minutes of a day, days of a season
};

} // namespace quarn::program
