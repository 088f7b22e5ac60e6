#pragma once

#include "engine/display/kernel/SkyGrid.h"

namespace quarn {
namespace {

inline LaneColors ambientLight(const FrameSetup& frame, const LaneVectors& normal) {
    const auto channel = [&](int c) {
        return dot(normal, frame.ambient_slope[c]) + frame.ambient_base[c];
    };
    return {channel(0), channel(1), channel(2)};
}

inline void addLight(const float (&color)[3], const Lanes& amount, LaneColors& light) {
    light.r = light.r + amount * color[0];
    light.g = light.g + amount * color[1];
    light.b = light.b + amount * color[2];
}

/// The light of the sky that arrives in the lanes of `lit`.
inline LaneColors skyLight(const FrameSetup& frame, const RayPacket& packet,
                           const SurfaceLanes& surfaces, const LaneMask& lit) {
    const LaneColors light = ambientLight(frame, surfaces.normal);
    if (!frame.free_sky || frame.hides_sky_of_ground_alone)
        return light;
    const Lanes arriving = skyArriving(frame, packet, surfaces, lit);
    return {light.r * arriving, light.g * arriving, light.b * arriving};
}

inline void addFixedLights(const FrameSetup& frame, const LaneVectors& normal, LaneColors& light) {
    for (int k = 0; k < frame.fixed_count; ++k) {
        const FrameLight& fixed = frame.fixed[k];
        addLight(fixed.color, greatest(dot(normal, fixed.toward), 0.0F), light);
    }
}

/// Adds the light of the suns.
/// @param also  is called with each sun, the cosine to it and the part of its light that arrives
template <class Also>
inline void addSuns(const FrameSetup& frame, const RayPacket& packet, const SurfaceLanes& surfaces,
                    const LaneMask& lit, LaneColors& light, const Also& also) {
    for (int k = 0; k < frame.sun_count; ++k) {
        const FrameLight& sun = frame.suns[k];
        const Lanes facing = greatest(dot(surfaces.normal, sun.toward), 0.0F);
        const Lanes arriving = sunlightArriving(frame, sun, packet, surfaces, lit, facing);
        addLight(sun.color, facing * arriving, light);
        also(sun, facing, arriving);
    }
}

/// The light that diffuse surfaces send to the observer, in the lanes of `lit`.
inline LaneColors shadeSurfaces(const FrameSetup& frame, const RayPacket& packet,
                                const SurfaceLanes& surfaces, const LaneMask& lit) {
    LaneColors light = skyLight(frame, packet, surfaces, lit);
    addFixedLights(frame, surfaces.normal, light);
    addSuns(frame, packet, surfaces, lit, light, [](const auto&...) {});
    return {surfaces.albedo.r * light.r, surfaces.albedo.g * light.g, surfaces.albedo.b * light.b};
}

} // namespace
} // namespace quarn
