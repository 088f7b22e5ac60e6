#pragma once

#include "engine/display/kernel/GroundPlane.h"
#include "engine/display/kernel/SunShadow.h"

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

/// Points that look for the sky.
struct SkyPoints {
    LaneVectors from; ///< a little off the surface
    LaneVectors face;
    LaneVectors normal;
    LaneMask wanted;
};

inline SkyPoints skyPoints(const FrameSetup& frame, const RayPacket& packet,
                           const SurfaceLanes& surfaces, const LaneMask& wanted) {
    const Lanes t = select(wanted, packet.distance, 0.0F);
    const LaneVectors place = along(packet.origin(), packet.direction(), t);
    return {along(place, surfaces.face, shadowOffset(frame, t, place) * 4.0F), surfaces.face,
            surfaces.normal, wanted & nearScene(frame, place)};
}

/// True where a ray can meet the box of the scene within its reach.
inline LaneMask reachesScene(const FrameSetup& frame, const LaneVectors& from,
                             const LaneVectors& direction, const Lanes& reach) {
    const Lanes* const place[3] = {&from.x, &from.y, &from.z};
    const Lanes* const toward[3] = {&direction.x, &direction.y, &direction.z};
    Lanes enter = 0.0F;
    Lanes leave = reach;
    for (int axis = 0; axis < 3; ++axis) {
        const Lanes& d = *toward[axis];
        const Lanes scale = Lanes(1.0F) / select(absolute(d) > 1e-12F, d, 1e-12F);
        const Lanes a = (Lanes(frame.scene_min[axis]) - *place[axis]) * scale;
        const Lanes b = (Lanes(frame.scene_max[axis]) - *place[axis]) * scale;
        enter = greatest(enter, least(a, b));
        leave = least(leave, greatest(a, b));
    }
    return ~(enter > leave);
}

/// Lets each point look in one direction.
/// @param toward  about the normal, which is (0, 0, 1)
/// @param reach   as a part of `sky_reach`
/// @return 1 where something stands before the sky, else 0
inline Lanes coveredToward(const FrameSetup& frame, const SkyPoints& points,
                           const LaneFrame& around, const LaneVectors& toward, const Lanes& reach,
                           RTCRay16& ray) {
    const LaneVectors& n = points.normal;
    const LaneVectors direction{toward.x * around.a.x + toward.y * around.b.x + toward.z * n.x,
                                toward.x * around.a.y + toward.y * around.b.y + toward.z * n.y,
                                toward.x * around.a.z + toward.y * around.b.z + toward.z * n.z};
    const Lanes length = reach * frame.sky_reach;
    // Below the triangle the ray would only meet the surface itself, rounded as it is.
    const LaneMask cast = points.wanted & (dot(points.face, direction) > Lanes(0.02F)) &
                          reachesScene(frame, points.from, direction, length);
    if (!any(cast))
        return 0.0F;
    setOrigin(ray, points.from);
    setDirection(ray, direction);
    store(ray.tfar, select(cast, length, no_distance));
    RTCIntersectContext context;
    rtcInitIntersectContext(&context);
    rtcOccluded16(cast.data(), frame.scene, &context, &ray);
    return select(cast & (load(ray.tfar) < 0.0F), 1.0F, 0.0F);
}

/// How much of the sky is free above the places of a tile, each of which looks in other directions.
inline Lanes freeSky(const FrameSetup& frame, const SkyPoints& points) {
    if (!any(points.wanted))
        return 1.0F;
    const LaneFrame around = frameAround(points.normal);
    RTCRay16 ray;
    prepare(ray);
    Lanes covered = 0.0F;
    for (const SkyDirections& d : frame.sky_table->shared)
        covered = covered + coveredToward(frame, points, around, {load(d.x), load(d.y), load(d.z)},
                                          load(d.reach), ray);
    return Lanes(1.0F) - covered * (1.0F / sky_rays);
}

/// How much of the sky is free above one point: that of one lane.
inline float freeSkyAlone(const FrameSetup& frame, const SkyPoints& points, int lane) {
    const auto everywhere = [&](const LaneVectors& v) {
        return LaneVectors{laneOf(v.x, lane), laneOf(v.y, lane), laneOf(v.z, lane)};
    };
    const SkyPoints point{everywhere(points.from), everywhere(points.face),
                          everywhere(points.normal), Lanes(0.0F) < 1.0F};
    const SkyDirections& directions = frame.sky_table->alone;
    RTCRay16 ray;
    prepare(ray);
    const Lanes covered = coveredToward(
        frame, point, frameAround(point.normal),
        {load(directions.x), load(directions.y), load(directions.z)}, load(directions.reach), ray);
    return 1.0F - static_cast<float>(__builtin_popcount(bits(covered > 0.5F))) / lane_count;
}

} // namespace
} // namespace quarn
