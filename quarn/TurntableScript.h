#pragma once

#include "quarn/TurntableRequest.h"

#include <optional>
#include <string>
#include <vector>

namespace quarn::program {

/// The host commands that record a turntable: one line each, in UTF-8.
struct TurntableScript {
    std::vector<std::string> set_up; ///< from the model file to the animation
    /// Keeps the document before the recording begins, so that one which is stopped keeps it too.
    std::optional<std::string> saving;
    std::string recording; ///< this and `saving` need the folder to be there
};

TurntableScript composeTurntable(const TurntableRequest& request);

} // namespace quarn::program
