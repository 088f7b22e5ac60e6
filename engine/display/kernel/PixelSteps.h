#pragma once

#include "engine/display/SurfaceLook.h"
#include "engine/display/kernel/FrameSetup.h"
#include "engine/display/kernel/NativeVectors.h"

#include <cstddef>
#include <cstdint>

namespace quarn {
namespace {

/// @param step  of a channel that is not visible yet
inline bool differVisibly(const FrameSetup& frame, std::size_t a, std::size_t b, int step) {
    bool apart = frame.objects[a] != frame.objects[b];
    for (int shift = 0; shift < 32; shift += 8) {
        const auto in_a = static_cast<int>(frame.pixels[a] >> shift & 0xFFU);
        const auto in_b = static_cast<int>(frame.pixels[b] >> shift & 0xFFU);
        apart |= in_a - in_b > step || in_b - in_a > step;
    }
    return apart;
}

/// Of the steps from one row to another those that are worth rays: within a mirror these are dear.
inline std::uint64_t worthRays(const FrameSetup& frame, std::size_t row, std::size_t other,
                               std::uint64_t steps) {
    std::uint64_t worth = 0;
    for (std::uint64_t rest = steps; rest != 0; rest &= rest - 1) {
        const auto at = static_cast<std::size_t>(__builtin_ctzll(rest));
        const std::uint32_t object = frame.objects[row + at];
        const SurfaceLook* const look = object != 0 ? frame.surfaces[object - 1].look : nullptr;
        if (!look || !look->shows_scene ||
            differVisibly(frame, row + at, other + at, visible_step_in_mirror))
            worth |= rest & -rest;
    }
    return worth;
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
                          other + static_cast<std::size_t>(i), visible_step))
            steps |= std::uint64_t{1} << i;
    return frame.mirrors_scene ? worthRays(frame, row, other, steps) : steps;
}

} // namespace
} // namespace quarn
