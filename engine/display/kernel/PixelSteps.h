#pragma once

#include "engine/display/kernel/FrameSetup.h"
#include "engine/display/kernel/NativeVectors.h"

#include <cstddef>
#include <cstdint>

namespace quarn {
namespace {

inline bool differVisibly(const FrameSetup& frame, std::size_t a, std::size_t b) {
    bool apart = frame.objects[a] != frame.objects[b];
    for (int shift = 0; shift < 32; shift += 8) {
        const auto in_a = static_cast<int>(frame.pixels[a] >> shift & 0xFFU);
        const auto in_b = static_cast<int>(frame.pixels[b] >> shift & 0xFFU);
        apart |= in_a - in_b > visible_step || in_b - in_a > visible_step;
    }
    return apart;
}

/// Compares a row of pixels with another one.
/// @param row, other  where they begin in the picture
/// @param count  pixels, at most 64
/// @return a bit for each pixel, the lowest for the first: set where the two differ visibly
std::uint64_t findSteps(const FrameSetup& frame, std::size_t row, std::size_t other, int count) {
    std::uint64_t steps = 0;
    int i = 0;
    for (; i + native_lanes <= count; i += native_lanes) {
        const auto at = static_cast<std::size_t>(i);
        const NativeInts beyond = nativeBeyond(nativeLoad(frame.pixels + row + at),
                                               nativeLoad(frame.pixels + other + at), visible_step);
        const NativeInts objects =
            nativeLoad(frame.objects + row + at) ^ nativeLoad(frame.objects + other + at);
        steps |= std::uint64_t{nativeSigns((beyond | objects) != 0)} << i;
    }
    for (; i < count; ++i)
        if (differVisibly(frame, row + static_cast<std::size_t>(i),
                          other + static_cast<std::size_t>(i)))
            steps |= std::uint64_t{1} << i;
    return steps;
}

} // namespace
} // namespace quarn
