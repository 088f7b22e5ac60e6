#pragma once

#include "kelmar/KM_Color.h"

#include <cstdint>

namespace quarn {

/// Lays a colour over a pixel as far as `amount` says, from 0 to 1. A pixel that is not opaque
/// becomes more so.
inline std::uint32_t blendedOver(std::uint32_t under, const KM_Color& over, float amount) {
    const std::uint32_t alpha = under >> 24;
    float opacity = 1.0F;
    float part = amount; // of the colour in what is seen
    if (alpha < 255) {
        opacity = amount + (1.0F - amount) * static_cast<float>(alpha) / 255.0F;
        part = opacity > 0.0F ? amount / opacity : 0.0F;
    }
    const auto mixed = [&](int shift, std::uint8_t channel) {
        const auto below = static_cast<float>(under >> shift & 255U);
        const float sum = (1.0F - part) * below + part * static_cast<float>(channel);
        return static_cast<std::uint32_t>(sum + 0.5F) << shift;
    };
    return mixed(0, over.r) | mixed(8, over.g) | mixed(16, over.b) |
           static_cast<std::uint32_t>(255.0F * opacity + 0.5F) << 24;
}

} // namespace quarn
