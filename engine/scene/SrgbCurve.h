#pragma once

#include <cmath>

namespace quarn {

// The transfer function of IEC 61966-2-1 (sRGB), both ways, from 0 to 1.

inline float linearFromSrgb(float value) {
    return value <= 0.04045F ? value / 12.92F : std::pow((value + 0.055F) / 1.055F, 2.4F);
}

inline float srgbFromLinear(float linear) {
    return linear <= 0.0031308F ? 12.92F * linear : 1.055F * std::pow(linear, 1.0F / 2.4F) - 0.055F;
}

} // namespace quarn
