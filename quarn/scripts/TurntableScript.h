#pragma once

#include "quarn/scripts/RecordingScript.h"
#include "quarn/scripts/TurntableRequest.h"

namespace quarn::program {

/// The host commands that frame the model and set a turntable up.
AnimationLines turntableLines(const TurntableRequest& request);

} // namespace quarn::program
