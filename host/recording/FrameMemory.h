#pragma once

#include "kelmar/KM_wString.h"

#include <cstdint>
#include <optional>

namespace quarn {

/// About so many bytes of memory an animation takes while it is set up and recorded: the camera and
/// the target of each frame, the copies of them that commands work on, the names of the pictures,
/// and the page that lists them.
std::uint64_t memoryOfFrames(int frames);

/// What an animation of so many frames would take where it does not fit into the memory that is
/// free, in the user's language and without a point at its end; nothing where it fits. Short ones
/// always do: the system is not asked.
std::optional<KM_wString> framesBeyondMemory(int frames);
/// The same, with what is free already known.
std::optional<KM_wString> framesBeyondMemory(int frames, std::uint64_t free_bytes);

} // namespace quarn
