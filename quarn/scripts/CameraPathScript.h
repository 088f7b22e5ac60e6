#pragma once

#include "quarn/scripts/CameraPathRequest.h"
#include "quarn/scripts/RecordingScript.h"

namespace quarn::program {

/// The host commands that make what is followed where it comes from a file or the command line,
/// choose the lens, and set the animation up.
AnimationLines cameraPathLines(const CameraPathRequest& request);

} // namespace quarn::program
