#pragma once

#include <cmath>
#include <cstdint>

namespace quarn {

/// A direction in 32 bits, by folding an octahedron into a square (Q. Meyer, J. Suessmuth,
/// G. Sussner, M. Stamminger and G. Greiner, "On Floating-Point Normal Vectors", EGSR 2010).
/// The error stays below 0.004 degrees.
///
/// @param x, y, z  any length; a zero or invalid vector is stored as (0, 0, 1)
inline std::uint32_t packNormal(float x, float y, float z) {
    const float sum = std::fabs(x) + std::fabs(y) + std::fabs(z);
    if (!(sum > 0.0F) || !std::isfinite(sum))
        return 0;
    float u = x / sum;
    float v = y / sum;
    if (z < 0.0F) {
        const float folded = (1.0F - std::fabs(v)) * (u < 0.0F ? -1.0F : 1.0F);
        v = (1.0F - std::fabs(u)) * (v < 0.0F ? -1.0F : 1.0F);
        u = folded;
    }
    const auto fixed = [](float value) {
        return static_cast<std::uint16_t>(static_cast<std::int16_t>(std::lrintf(value * 32767.0F)));
    };
    return static_cast<std::uint32_t>(fixed(u)) | (static_cast<std::uint32_t>(fixed(v)) << 16);
}

/// The direction that packNormal stored, not of unit length.
inline void unpackNormal(std::uint32_t packed, float (&direction)[3]) {
    const auto bits = static_cast<std::int32_t>(packed);
    const float u = static_cast<float>(static_cast<std::int16_t>(bits)) / 32767.0F;
    const float v = static_cast<float>(bits >> 16) / 32767.0F;
    const float z = 1.0F - std::fabs(u) - std::fabs(v);
    const float fold = z < 0.0F ? z : 0.0F;
    direction[0] = u + (u < 0.0F ? -fold : fold);
    direction[1] = v + (v < 0.0F ? -fold : fold);
    direction[2] = z;
}

} // namespace quarn
