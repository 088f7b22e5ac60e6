#include "engine/images/Image.h"

#include <limits>

namespace quarn {

float DepthImage::depth(int x, int y) const {
    const float near = nearness[static_cast<std::size_t>(y) * static_cast<std::size_t>(width) +
                                static_cast<std::size_t>(x)];
    if (near <= 0.0F)
        return std::numeric_limits<float>::infinity();
    return parallel ? reference_depth - near : 1.0F / near;
}

void DepthImage::resize(int new_width, int new_height) {
    width = new_width;
    height = new_height;
    nearness.resize(static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
}

} // namespace quarn
