#pragma once

#include <vector>

namespace quarn {

/// A picture of what lies around a scene on all sides, in linear light: rows run from straight up
/// to straight down by the angle, columns once around, to the right; the middle column lies toward
/// +y.
struct EnvironmentPicture {
    int width = 0;          ///< pixels
    int height = 0;         ///< pixels
    std::vector<float> rgb; ///< 3 * width * height, row by row; finite and not below 0
};

} // namespace quarn
