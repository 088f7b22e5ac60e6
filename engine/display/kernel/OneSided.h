#pragma once

#include "engine/display/FrontsAlone.h"
#include "engine/display/kernel/SurfaceLanes.h"

namespace quarn {
namespace {

/// The lanes that met the back of a one-sided surface.
inline LaneMask backsMet(const FrameSetup& frame, const RayPacket& packet) {
    const LaneVectors normal = geometricNormals(frame, packet);
    const LaneInts surfaces = surfacesMet(frame, packet);
    alignas(64) std::uint32_t met[lane_count];
    store(met, surfaces);
    LaneMask backs = noLanes();
    unsigned rest = bits(packet.hit);
    while (rest != 0) {
        const std::uint32_t index = met[__builtin_ctz(rest)];
        const LaneMask mask = packet.hit & (surfaces == LaneInts(static_cast<std::int32_t>(index)));
        rest &= ~bits(mask);
        const RaySurface& surface = frame.surfaces[index];
        if (!surface.one_sided)
            continue;
        const LaneVectors front =
            surface.place ? turned(surface.place->cofactors, normal) * Lanes(surface.place->hand)
                          : normal;
        backs = backs | (mask & (dot(front, packet.direction()) > 0.0F));
    }
    return backs;
}

/// Finds the nearest surface of each ray that is seen from where the ray comes from. Most rays meet
/// one at once; only for the others the ray tracer has to ask about every surface.
inline void intersectFronts(const FrameSetup& frame, RayPacket& packet,
                            RTCIntersectContextFlags flags = RTC_INTERSECT_CONTEXT_FLAG_COHERENT) {
    intersect(frame, packet, flags);
    if (!frame.has_one_sided)
        return;
    const LaneMask again = backsMet(frame, packet);
    if (!any(again))
        return;
    RTCRayHit16& rays = packet.rays;
    constexpr auto nothing = static_cast<std::int32_t>(RTC_INVALID_GEOMETRY_ID);
    store(rays.ray.tfar, select(again, Lanes(unlimited), packet.distance));
    store(rays.hit.geomID, select(again, LaneInts(nothing), load(rays.hit.geomID)));
    store(rays.hit.instID[0], select(again, LaneInts(nothing), load(rays.hit.instID[0])));
    FrontsAlone fronts{{},
                       frame.surfaces,
                       frame.first_surfaces,
                       static_cast<std::uint32_t>(frame.sole_first_surface)};
    passBacks(fronts);
    rtcIntersect16(again.data(), frame.scene, &fronts.context, &rays);
    packet.hit = load(rays.hit.geomID) != nothing;
    packet.distance = load(rays.ray.tfar);
}

} // namespace
} // namespace quarn
