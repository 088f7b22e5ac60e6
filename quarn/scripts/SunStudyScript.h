#pragma once

#include "quarn/scripts/RecordingScript.h"
#include "quarn/scripts/SunStudyRequest.h"

namespace quarn::program {

/// The host commands that place the camera and set the study up, and the note on its clock.
AnimationLines sunStudyLines(const SunStudyRequest& request);

} // namespace quarn::program
