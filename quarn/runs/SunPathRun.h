#pragma once

#include "host/session/SunPath.h"
#include "quarn/session/HostSession.h"
#include "quarn/words/Outcome.h"

#include <filesystem>
#include <string>

namespace quarn::program {

/// A sun path diagram that is to be written.
struct SunPathOrder {
    SunPathRequest diagram;
    std::filesystem::path model; ///< empty: none
    std::string zone_note{};     ///< a sentence without its full stop; empty: nothing
    CommonOptions common;
};

/// `quarn sunpath`: draws the diagram, with what the model hides of the sky where there is one.
Outcome drawSunPath(const SunPathOrder& order);

} // namespace quarn::program
