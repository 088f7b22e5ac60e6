#pragma once

#include "host/display/kernel/GroundPlane.h"
#include "host/display/kernel/SunShadow.h"

namespace quarn {
namespace {

/// Two unit vectors that stand on a unit vector and on each other (T. Duff, J. Burgess, P.
/// Christensen, C. Hery, A. Kensler, M. Liani and R. Villemin, "Building an Orthonormal Basis,
/// Revisited", Journal of Computer Graphics Techniques, 2017).
struct LaneFrame {
    LaneVectors a;
    LaneVectors b;
};

inline LaneFrame frameAround(const LaneVectors& n) {
    const Lanes sign = select(n.z < 0.0F, -1.0F, 1.0F);
    const Lanes p = Lanes(-1.0F) / (sign + n.z);
    const Lanes q = n.x * n.y * p;
    return {{Lanes(1.0F) + sign * n.x * n.x * p, sign * q, -(sign * n.x)},
            {q, sign + n.y * n.y * p, -n.y}};
}

/// True within reach of the box of the scene: elsewhere nothing can stand before the sky.
inline LaneMask nearScene(const FrameSetup& frame, const LaneVectors& place) {
    const auto within = [&](const Lanes& coordinate, int axis) {
        return (coordinate > Lanes(frame.scene_min[axis] - frame.sky_reach)) &
               (coordinate < Lanes(frame.scene_max[axis] + frame.sky_reach));
    };
    return within(place.x, 0) & within(place.y, 1) & within(place.z, 2);
}

/// How much of the sky above a surface is free, as far as `sky_reach`: each lane looks in some
/// directions of its own, and the lanes of a tile together look in all.
inline Lanes freeSky(const FrameSetup& frame, const RayPacket& packet, const SurfaceLanes& surfaces,
                     const LaneMask& wanted) {
    const Lanes t = select(wanted, packet.distance, 0.0F);
    const LaneVectors place = along(packet.origin, packet.direction, t);
    const LaneMask look = wanted & nearScene(frame, place);
    if (!any(look))
        return 1.0F;
    const LaneFrame around = frameAround(surfaces.normal);
    RTCRay16 ray;
    prepare(ray);
    Lanes covered = 0.0F;
    for (int k = 0; k < sky_rays; ++k) {
        const SkyDirections& table = frame.sky_directions[k];
        const Lanes x = load(table.x);
        const Lanes y = load(table.y);
        const Lanes z = load(table.z);
        const LaneVectors& n = surfaces.normal;
        const LaneVectors direction{x * around.a.x + y * around.b.x + z * n.x,
                                    x * around.a.y + y * around.b.y + z * n.y,
                                    x * around.a.z + y * around.b.z + z * n.z};
        // Below the triangle the ray would only meet the surface itself, rounded as it is.
        const LaneMask cast = look & (dot(surfaces.face, direction) > Lanes(0.02F));
        if (!any(cast))
            continue;
        setOrigin(ray, along(place, surfaces.face, shadowOffset(frame, t, place) * 4.0F));
        setDirection(ray, direction);
        store(ray.tfar, select(cast, load(table.reach) * frame.sky_reach, no_distance));
        RTCIntersectContext context;
        rtcInitIntersectContext(&context);
        rtcOccluded16(cast.data(), frame.scene, &context, &ray);
        covered = covered + select(cast & (load(ray.tfar) < 0.0F), 1.0F, 0.0F);
    }
    return Lanes(1.0F) - covered * (1.0F / sky_rays);
}

/// Fills one tile's places and free sky.
inline void keepFreeSky(const FrameSetup& frame, const RayPacket& packet,
                        const SurfaceLanes& surfaces, const LaneMask& seen, const Lanes& free) {
    alignas(64) float values[5][lane_count];
    store(values[0], surfaces.normal.x);
    store(values[1], surfaces.normal.y);
    store(values[2], surfaces.normal.z);
    store(values[3], select(seen, packet.distance, no_distance));
    store(values[4], free);
    alignas(64) float x[lane_count];
    alignas(64) float y[lane_count];
    store(x, packet.x);
    store(y, packet.y);
    const unsigned active = bits(packet.active);
    for (int i = 0; i < lane_count; ++i) {
        if (!(active >> i & 1U))
            continue;
        const auto pixel = static_cast<std::size_t>(y[i]) * static_cast<std::size_t>(frame.width) +
                           static_cast<std::size_t>(x[i]);
        frame.sky_places[pixel] = {{values[0][i], values[1][i], values[2][i]}, values[3][i]};
        frame.free_sky[pixel] = values[4][i];
    }
}

inline float lookAlike(const SkyPlace& place, const float (&normal)[3], float distance) {
    const float facing =
        normal[0] * place.normal[0] + normal[1] * place.normal[1] + normal[2] * place.normal[2];
    const float ratio = place.distance / distance;
    const float step = ratio > 1.0F ? ratio - 1.0F : 1.0F - ratio;
    return place.distance < 0.0F ? -1e6F : facing - 30.0F * step;
}

/// The free sky at one place of the picture: that of the pixel there if it shows the same surface,
/// else that of the neighbour which looks most alike.
inline float freeSkyNear(const FrameSetup& frame, int x, int y, const float (&normal)[3],
                         float distance) {
    const auto offset = [&](int column, int row) {
        return static_cast<std::size_t>(row) * static_cast<std::size_t>(frame.width) +
               static_cast<std::size_t>(column);
    };
    std::size_t best = offset(x, y);
    float likeness = lookAlike(frame.sky_places[best], normal, distance);
    if (likeness > 0.9F)
        return frame.free_sky[best];
    for (int dy = -1; dy <= 1; ++dy)
        for (int dx = -1; dx <= 1; ++dx) {
            const int column = x + dx;
            const int row = y + dy;
            if (column < 0 || row < 0 || column >= frame.width || row >= frame.height)
                continue;
            const std::size_t there = offset(column, row);
            const float alike = lookAlike(frame.sky_places[there], normal, distance);
            if (alike > likeness) {
                likeness = alike;
                best = there;
            }
        }
    return frame.free_sky[best];
}

/// The part of the sky's light that arrives at the lit lanes, from the finished pass.
inline Lanes skyArriving(const FrameSetup& frame, const RayPacket& packet,
                         const SurfaceLanes& surfaces, const LaneMask& lit) {
    alignas(64) float x[lane_count];
    alignas(64) float y[lane_count];
    alignas(64) float n[3][lane_count];
    alignas(64) float distance[lane_count];
    alignas(64) float free[lane_count];
    store(x, packet.x);
    store(y, packet.y);
    store(n[0], surfaces.normal.x);
    store(n[1], surfaces.normal.y);
    store(n[2], surfaces.normal.z);
    store(distance, packet.distance);
    const unsigned wanted = bits(lit);
    for (int i = 0; i < lane_count; ++i) {
        free[i] = 1.0F;
        if (!(wanted >> i & 1U))
            continue;
        const float normal[3] = {n[0][i], n[1][i], n[2][i]};
        free[i] =
            freeSkyNear(frame, static_cast<int>(x[i]), static_cast<int>(y[i]), normal, distance[i]);
    }
    return load(free);
}

} // namespace
} // namespace quarn
