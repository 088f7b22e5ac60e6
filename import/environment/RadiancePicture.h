#pragma once

#include "engine/scene/EnvironmentPicture.h"
#include "ground/Result.h"

#include <cstdint>
#include <span>

namespace quarn {

/// Decodes a Radiance picture, whose numbers may be any.
/// @param most_pixels  a larger one is refused before memory is asked for
/// @return an error, a part of a sentence: it is of another kind, damaged, cut off or too large
Result<EnvironmentPicture> decodeRadiance(std::span<const std::uint8_t> bytes,
                                          std::int64_t most_pixels);

} // namespace quarn
