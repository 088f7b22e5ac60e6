#pragma once

#include "engine/display/kernel/FrameSetup.h"

#include <span>

namespace quarn {

struct DirectionPacket {
    alignas(64) float axes[3][lane_count];
};
/// Directions all over the sphere, equally spaced, from above to below.
std::span<const DirectionPacket> directionsAround();

/// Sets the ambient light and the light that the ground sends from what lies around by `frame`, so
/// that matt surfaces get what mirrors show. See AmbientLight for the source.
/// @param frame  all else of its light is known
void setAmbientFromAround(FrameSetup& frame);

/// Calls take(x, y, z, colour) for many directions of unit length, evenly spread over all sides,
/// with what rough surfaces see there of all that lies around and of the ground.
template <class Take> void lookAround(const FrameSetup& frame, const Take& take) {
    const RayKernel& kernel = rayKernelInForce();
    alignas(64) float colors[3][lane_count];
    for (const DirectionPacket& packet : directionsAround()) {
        kernel.find_light_around(frame, packet.axes, colors);
        for (int i = 0; i < lane_count; ++i) {
            const float color[3] = {colors[0][i], colors[1][i], colors[2][i]};
            take(packet.axes[0][i], packet.axes[1][i], packet.axes[2][i], color);
        }
    }
}

} // namespace quarn
