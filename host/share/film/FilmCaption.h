#pragma once

#include "ground/Result.h"
#include "host/recording/FramesManifest.h"

#include <filesystem>

namespace quarn {

/// What is drawn into a frame: "2026-06-21  14:30  UTC+1".
/// @param sun   of the frame; nothing where it tells no time
/// @param film  for the message
Result<std::string> captionOf(const std::optional<FrameSun>& sun,
                              const std::filesystem::path& film);

} // namespace quarn
