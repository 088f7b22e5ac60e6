#pragma once

#include "quarn/RecordingScript.h"
#include "quarn/TurntableRequest.h"

namespace quarn::program {

/// The host commands that frame the model and set a turntable up.
AnimationLines turntableLines(const TurntableRequest& request);

} // namespace quarn::program
