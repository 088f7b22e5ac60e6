#pragma once

#include "quarn/farm/FarmRequest.h"
#include "quarn/farm/SlurmText.h"
#include "quarn/session/HostSession.h"

#include <variant>

namespace quarn::program {

/// What is to be submitted.
struct FarmPlan {
    std::string name; ///< of the animation, UTF-8
    int frames = 0;   ///< of the whole animation
    int missing = 0;
    FrameCost cost{};
    FrameChunks chunks{};
};

/// Reads the document, looks what its folder holds, and shares out the frames that are missing.
/// Draws one of them where nobody says how long it takes.
/// @return how the program ends where nothing is to be submitted: there is no animation, all frames
///         are there or still recorded, the folder holds another recording, the time is too
///         short
std::variant<FarmPlan, Outcome> planFarm(const FarmRequest& request, const CommonOptions& common,
                                         const SlurmLimits& limits);

/// How many chunks of how many frames, and why so.
std::string planText(const FarmPlan& plan, const FarmRequest& request);

} // namespace quarn::program
