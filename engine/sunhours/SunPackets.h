#pragma once

#include "engine/sunhours/SurfacePoints.h"

#include <embree3/rtcore.h>

#include <algorithm>
#include <cstdint>
#include <span>

namespace quarn {

/// A step of the sun as its rays need it.
struct SunRayStep {
    float toward[3];
    float hours;
    std::size_t index; ///< among all steps
};

/// Where the light of packets is noted.
struct PacketLight {
    float* hours;       ///< sixteen for each packet, to begin with 0
    std::uint16_t* lit; ///< by step and packet, a bit for each point; null: nobody asks
    std::size_t stride; ///< of steps
};

/// Less than that of the cosine to the sun counts as turned away.
inline constexpr float least_facing = 1e-5F;
inline constexpr float sun_distance = 1e30F;

/// What of a packet looks toward the sun.
struct FacingPoints {
    alignas(64) float offset[points_at_once]; ///< along the face, where rays start
    alignas(64) std::uint32_t bit[points_at_once];
    alignas(64) int valid[points_at_once]; ///< as the ray tracer wants it
    unsigned bits;
};

inline void findFacing(const PointPacket& packet, const float (&toward)[3], FacingPoints& facing) {
    for (int i = 0; i < points_at_once; ++i) {
        const float cosine = packet.face[0][i] * toward[0] + packet.face[1][i] * toward[1] +
                             packet.face[2][i] * toward[2];
        const float side = cosine < 0.0F ? packet.back[i] : 1.0F;
        facing.offset[i] = side * packet.lift[i];
        facing.bit[i] = cosine * side > least_facing ? 1U << i : 0U;
        facing.valid[i] = cosine * side > least_facing ? -1 : 0;
    }
    facing.bits = 0;
    for (int i = 0; i < points_at_once; ++i)
        facing.bits |= facing.bit[i];
}

inline void setOrigins(const PointPacket& packet, const FacingPoints& facing, RTCRay16& rays) {
    for (int i = 0; i < points_at_once; ++i) {
        rays.org_x[i] = packet.place[0][i] + packet.face[0][i] * facing.offset[i];
        rays.org_y[i] = packet.place[1][i] + packet.face[1][i] * facing.offset[i];
        rays.org_z[i] = packet.place[2][i] + packet.face[2][i] * facing.offset[i];
        rays.tfar[i] = sun_distance;
    }
}

inline void startRays(RTCRay16& rays) {
    std::fill_n(rays.tnear, points_at_once, 0.0F);
    std::fill_n(rays.time, points_at_once, 0.0F);
    std::fill_n(rays.mask, points_at_once, ~0U);
    std::fill_n(rays.id, points_at_once, 0U);
    std::fill_n(rays.flags, points_at_once, 0U);
}

inline void aimAtSun(const SunRayStep& step, RTCRay16& rays) {
    std::fill_n(rays.dir_x, points_at_once, step.toward[0]);
    std::fill_n(rays.dir_y, points_at_once, step.toward[1]);
    std::fill_n(rays.dir_z, points_at_once, step.toward[2]);
}

/// @return a bit for each point whose ray met nothing
inline unsigned addLight(const FacingPoints& facing, const RTCRay16& rays, float hours,
                         float* sums) {
    alignas(64) std::uint32_t lit[points_at_once];
    for (int i = 0; i < points_at_once; ++i) {
        lit[i] = rays.tfar[i] < 0.0F ? 0U : facing.bit[i];
        sums[i] += lit[i] != 0 ? hours : 0.0F;
    }
    unsigned bits = 0;
    for (int i = 0; i < points_at_once; ++i)
        bits |= lit[i];
    return bits;
}

/// Looks from the points of packets [begin, end) toward the sun of each step.
/// @param occluded  what the ray tracer does with those of sixteen rays that are valid: makes tfar
///                  negative where something is met
template <class Occluded>
void lightPackets(const std::vector<PointPacket>& packets, std::size_t begin, std::size_t end,
                  std::span<const SunRayStep> steps, const PacketLight& light,
                  const Occluded& occluded) {
    RTCRay16 rays;
    FacingPoints facing;
    startRays(rays);
    for (const SunRayStep& step : steps) {
        aimAtSun(step, rays);
        for (std::size_t p = begin; p < end; ++p) {
            findFacing(packets[p], step.toward, facing);
            if (facing.bits == 0)
                continue;
            setOrigins(packets[p], facing, rays);
            occluded(facing.valid, rays);
            const unsigned lit =
                addLight(facing, rays, step.hours, light.hours + p * points_at_once);
            if (light.lit)
                light.lit[step.index * light.stride + p] = static_cast<std::uint16_t>(lit);
        }
    }
}

} // namespace quarn
