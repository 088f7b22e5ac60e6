#pragma once

#include "engine/images/Image.h"
#include "ground/Result.h"
#include "host/sunpath/Drawing.h"

#include <filesystem>

namespace quarn {

/// Draws a drawing as a picture on white.
/// @param scale  pixels of the picture for each of the drawing
/// @param font   a TrueType file; letters that it lacks are boxes
/// @return an error when the font cannot be read
Result<Image> pictureOf(const Drawing& drawing, double scale, const std::filesystem::path& font);

} // namespace quarn
