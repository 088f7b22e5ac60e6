#pragma once

#include "kelmar/KM_wString.h"

#include <optional>

namespace quarn {

class Application;

/// Whether a whole number that a person gives the running command is the number of frames of an
/// animation that memory cannot hold. Only the commands that set up an animation of cameras ask for
/// such a number.
/// @return what it would take, as a refusal without a point; nothing for every other number
std::optional<KM_wString> refuseFrameCount(Application& application, int number);

} // namespace quarn
