#pragma once

// Part of the ray loops, which are compiled once for each kind of processor. Everything here has
// internal linkage, and nothing inline is taken from other headers, so that the linker never puts
// code for a newer processor in place of code for an older one.

#include "host/display/kernel/FrameSetup.h"

#include <cstdint>

namespace quarn {
namespace {

/// A number for each ray of a packet.
struct alignas(64) Lanes {
    float v[lane_count];
};

/// -1 for the rays that are meant, 0 for the others.
struct alignas(64) LaneMask {
    int v[lane_count];
};

struct LaneVectors {
    Lanes x;
    Lanes y;
    Lanes z;
};

struct LaneColors {
    Lanes r;
    Lanes g;
    Lanes b;
};

inline float least(float a, float b) {
    return a < b ? a : b;
}
inline float greatest(float a, float b) {
    return a > b ? a : b;
}
inline float absolute(float a) {
    return __builtin_fabsf(a);
}
inline float squareRoot(float a) {
    return __builtin_sqrtf(a);
}
inline float clamped(float a) {
    return least(greatest(a, 0.0F), 1.0F);
}

inline bool any(const LaneMask& mask) {
    int bits = 0;
    for (int i = 0; i < lane_count; ++i)
        bits |= mask.v[i];
    return bits != 0;
}

} // namespace
} // namespace quarn
