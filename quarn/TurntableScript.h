#pragma once

#include "quarn/TurntableRequest.h"

#include <string>
#include <vector>

namespace quarn::program {

/// The host commands that record a turntable: one line each, in UTF-8.
struct TurntableScript {
    std::vector<std::string> set_up; ///< from the model file to the animation
    std::string recording;           ///< needs the folder to be there
};

TurntableScript composeTurntable(const TurntableRequest& request);

} // namespace quarn::program
