#pragma once

#include "host/almanac/StudyCourse.h"
#include "quarn/scripts/RecordingRequest.h"
#include "quarn/scripts/StudyView.h"

namespace quarn::program {

/// The sun through a day or a year.
struct SunStudyRequest {
    RecordingRequest recording;
    StudyCourse course;
    StudyView view;
};

} // namespace quarn::program
