#pragma once

#include "engine/scene/EnvironmentPicture.h"
#include "ground/Result.h"

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <span>

namespace quarn {

/// A picture of surroundings, as it was read.
struct EnvironmentReading {
    EnvironmentPicture picture;
    /// Pixels that were brighter than a million in a channel, below 0 or no numbers. They were made
    /// as bright as that, in their own colour, or black.
    std::size_t moved_pixels = 0;
};

/// The most pixels that a picture of surroundings may have.
inline constexpr std::int64_t MOST_ENVIRONMENT_PIXELS = std::int64_t{8192} * 4096;

/// Reads a Radiance picture.
/// @return an error, a part of a sentence: it is of another kind, damaged, cut off or too large, or
///         there is too little memory
Result<EnvironmentReading> decodeEnvironment(std::span<const std::uint8_t> bytes);

/// Reads a Radiance picture file (.hdr), whose middle column lies toward +y.
/// @return an error in a sentence that names the file, why it is not read and what to do
Result<EnvironmentReading> readEnvironment(const std::filesystem::path& file);

} // namespace quarn
