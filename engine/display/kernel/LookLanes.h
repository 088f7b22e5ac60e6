#pragma once

#include "engine/display/SurfaceLook.h"
#include "engine/display/kernel/LookPaint.h"
#include "engine/display/kernel/SurfaceLanes.h"

namespace quarn {
namespace {

/// What the surfaces that a packet met look like beyond their base colours. Lanes whose surface has
/// no look, or that met none, are matt and dark.
struct LookLanes {
    LaneMask unlit;
    LaneMask mirrors;
    LaneColors emission;
    LaneColors f0; ///< what no metal mirrors, seen straight on and along its face
    Lanes f90;
    Lanes metalness;
    Lanes roughness;
};

inline LookLanes mattLooks() {
    const LaneMask none = Lanes(0.0F) < 0.0F;
    const LaneColors black{0.0F, 0.0F, 0.0F};
    return {none, none, black, black, 0.0F, 0.0F, 1.0F};
}

/// Numbers of one quality, lane by lane.
inline float* numbersOf(Lanes& lanes) {
    return reinterpret_cast<float*>(lanes.part);
}

inline void readLookTextures(const FrameSetup& frame, const RaySurface& surface,
                             const RayPacket& packet, unsigned lanes_meant, LookLanes& looks) {
    float* const emission[3] = {numbersOf(looks.emission.r), numbersOf(looks.emission.g),
                                numbersOf(looks.emission.b)};
    float* const metalness = numbersOf(looks.metalness);
    float* const roughness = numbersOf(looks.roughness);
    for (; lanes_meant != 0; lanes_meant &= lanes_meant - 1) {
        const int i = __builtin_ctz(lanes_meant);
        const float place[3] = {packet.rays.hit.u[i], packet.rays.hit.v[i],
                                packet.rays.ray.tfar[i]};
        PaintedLook painted{
            {emission[0][i], emission[1][i], emission[2][i]}, metalness[i], roughness[i]};
        paintLookAt(frame, surface, packet.rays, i, place, painted);
        for (int c = 0; c < 3; ++c)
            emission[c][i] = painted.emission[c];
        metalness[i] = painted.metalness;
        roughness[i] = painted.roughness;
    }
}

inline void readLook(const FrameSetup& frame, const RaySurface& surface, const RayPacket& packet,
                     const LaneMask& mask, LookLanes& looks) {
    const SurfaceLook& look = *surface.look;
    if (look.is_unlit)
        looks.unlit = looks.unlit | mask;
    looks.emission = select(mask, uniformColor(look.emission), looks.emission);
    if (frame.has_mirrors && look.mirrors) {
        looks.mirrors = looks.mirrors | mask;
        looks.f0 = select(mask, uniformColor(look.f0), looks.f0);
        looks.f90 = select(mask, Lanes(look.f90), looks.f90);
        looks.metalness = select(mask, Lanes(look.metalness), looks.metalness);
        looks.roughness = select(mask, Lanes(look.roughness), looks.roughness);
    }
    if (look.has_textures)
        readLookTextures(frame, surface, packet, bits(mask), looks);
}

/// Fills `looks` for the rays that hit something.
/// @return false where no surface has a look; then `looks` is not filled
inline bool readLooks(const FrameSetup& frame, const RayPacket& packet,
                      const SurfaceLanes& surfaces, LookLanes& looks) {
    alignas(64) std::uint32_t met[lane_count];
    store(met, surfaces.surface);
    bool found = false;
    unsigned rest = bits(packet.hit);
    while (rest != 0) {
        const std::uint32_t index = met[__builtin_ctz(rest)];
        const LaneMask mask =
            packet.hit & (surfaces.surface == LaneInts(static_cast<std::int32_t>(index)));
        rest &= ~bits(mask);
        if (!frame.surfaces[index].look)
            continue;
        if (!found)
            looks = mattLooks();
        found = true;
        readLook(frame, frame.surfaces[index], packet, mask, looks);
    }
    return found;
}

} // namespace
} // namespace quarn
