#pragma once

#include "engine/scene/SrgbCurve.h"
#include "kelmar/KM_Color.h"

#include <algorithm>
#include <cstdint>

namespace quarn {

/// 0 to 1 as a byte; what lies outside is moved to the limit, and what is no number counts as 0.
inline std::uint8_t byteFromUnit(float value) {
    return value > 0.0F ? static_cast<std::uint8_t>(std::min(value, 1.0F) * 255.0F + 0.5F) : 0;
}

/// A colour whose channels from 0 to 1 are sRGB already.
inline KM_Color colorFromSrgb(float r, float g, float b, float a) {
    return {byteFromUnit(r), byteFromUnit(g), byteFromUnit(b), byteFromUnit(a)};
}

/// A colour whose channels from 0 to 1 are linear light; opacity is linear in both.
inline KM_Color colorFromLinear(float r, float g, float b, float a) {
    return colorFromSrgb(srgbFromLinear(r), srgbFromLinear(g), srgbFromLinear(b), a);
}

} // namespace quarn
