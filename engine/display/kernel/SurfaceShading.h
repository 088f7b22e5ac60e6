#pragma once

#include "engine/display/kernel/LampLight.h"
#include "engine/display/kernel/OpenGround.h"
#include "engine/display/kernel/SkyGrid.h"

namespace quarn {
namespace {

/// What changes with the square of the normal.
inline LaneColors ambientSquares(const FrameSetup& frame, const LaneVectors& n) {
    const Lanes terms[5] = {n.x * n.y, n.y * n.z, n.z * n.z * 3.0F - 1.0F, n.x * n.z,
                            n.x * n.x - n.y * n.y};
    const auto channel = [&](int c) {
        Lanes sum = 0.0F;
        for (int i = 0; i < 5; ++i)
            sum = sum + terms[i] * frame.ambient_square[c][i];
        return sum;
    };
    return {channel(0), channel(1), channel(2)};
}

/// The light from all around on surfaces that nothing hides it from.
inline LaneColors ambientLight(const FrameSetup& frame, const LaneVectors& normal) {
    const auto channel = [&](int c) {
        return dot(normal, frame.ambient_slope[c]) + frame.ambient_base[c];
    };
    const LaneColors light{channel(0), channel(1), channel(2)};
    if (!frame.has_ambient_square)
        return light;
    return light + ambientSquares(frame, normal);
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
    if (!frame.free_sky && !frame.ground_map.open)
        return light;
    const Lanes arriving = frame.free_sky ? skyArriving(frame, packet, surfaces, lit)
                                          : openAboveGround(frame, packet, surfaces.normal, lit);
    return {light.r * arriving, light.g * arriving, light.b * arriving};
}

inline void addFixedLights(const FrameSetup& frame, const LaneVectors& normal, LaneColors& light) {
    for (int k = 0; k < frame.fixed_count; ++k) {
        const FrameLight& fixed = frame.fixed[k];
        addLight(fixed.color, greatest(dot(normal, fixed.toward), 0.0F), light);
    }
}

/// The mirrors of surfaces that have none: they show every light, on what is matt.
struct NoMirrors {
    static LaneMask show(const LaneColors&, const LaneVectors&, const Lanes& facing) {
        return facing > 0.0F;
    }
    static void add(const LaneColors&) {}
};

/// Adds the light that shadows keep off: of suns and lamps.
/// @param mirrors  for each of them mirrors.show(its light, unit vectors to it, the cosine to
///   these) says in which lanes it would be seen: the others send no shadow ray, and shine as if
///   nothing stood before the light. Then mirrors.add takes the light that arrives.
template <class Mirrors>
inline void addLights(const FrameSetup& frame, const RayPacket& packet,
                      const SurfaceLanes& surfaces, const LaneMask& lit, LaneColors& light,
                      Mirrors& mirrors) {
    for (int k = 0; k < frame.sun_count; ++k) {
        const FrameLight& sun = frame.suns[k];
        const Lanes facing = greatest(dot(surfaces.normal, sun.toward), 0.0F);
        const LaneVectors toward{sun.toward[0], sun.toward[1], sun.toward[2]};
        const LaneMask shown = lit & mirrors.show(uniformColor(sun.color), toward, facing);
        const Lanes arriving = sunlightArriving(frame, sun, packet, surfaces, shown);
        addLight(sun.color, facing * arriving, light);
        mirrors.add(uniformColor(sun.color) * arriving);
    }
    if (frame.lamp_count > 0)
        addLamps(frame, packet, surfaces, lit, light, mirrors);
}

/// The light that diffuse surfaces send to the observer, in the lanes of `lit`.
inline LaneColors shadeSurfaces(const FrameSetup& frame, const RayPacket& packet,
                                const SurfaceLanes& surfaces, const LaneMask& lit) {
    LaneColors light = skyLight(frame, packet, surfaces, lit);
    addFixedLights(frame, surfaces.normal, light);
    NoMirrors none;
    addLights(frame, packet, surfaces, lit, light, none);
    return {surfaces.albedo.r * light.r, surfaces.albedo.g * light.g, surfaces.albedo.b * light.b};
}

} // namespace
} // namespace quarn
