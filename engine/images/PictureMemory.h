#pragma once

#include "ground/Result.h"

#include <cstdint>

namespace quarn {

/// About so many bytes are needed to draw a picture and to write it to a file: its colours, what
/// each pixel shows and how near it is, and the file.
std::uint64_t pictureBytes(int width_px, int height_px);

/// Looks whether a picture fits into memory before any of its work begins. Small pictures always
/// do.
/// @param held_px  pixels of the largest picture for which memory is held already
/// @return an error that says how much memory is needed and how much is free
Result<void> checkPictureMemory(int width_px, int height_px, std::int64_t held_px = 0);

/// The same, with what is free already known.
Result<void> checkPictureMemory(int width_px, int height_px, std::int64_t held_px,
                                std::uint64_t free_bytes);

} // namespace quarn
