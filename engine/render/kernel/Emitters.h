#pragma once

#include "engine/display/kernel/LookLanes.h"
#include "engine/render/kernel/ShadowRays.h"

namespace quarn {
namespace {

// Surfaces that shine. Rays are sent to places of their triangles, the more the brighter these are,
// and both ways of finding their light, this one and by chance, are weighed against each other
// (E. Veach, "Robust Monte Carlo Methods for Light Transport Simulation", 1997, 9.2).

/// The weight of a way that finds a direction with the first density, beside one with the second.
inline Lanes weightBeside(const Lanes& density, const Lanes& other) {
    const Lanes square = density * density;
    return square / greatest(square + other * other, 1e-30F);
}

/// Rec. 709 luminance.
inline float emitterBrightness(const float (&emission)[3]) {
    return 0.2126F * emission[0] + 0.7152F * emission[1] + 0.0722F * emission[2];
}

/// How bright the surfaces shine that a packet met, by their materials' numbers alone: so much are
/// places on them preferred.
inline Lanes preferenceOf(const FrameSetup& frame, const SurfaceLanes& surfaces,
                          const LaneMask& shining) {
    Lanes preference = 0.0F;
    auto* const lanes = reinterpret_cast<float*>(preference.part);
    alignas(64) std::uint32_t met[lane_count];
    store(met, surfaces.surface);
    for (unsigned rest = bits(shining); rest != 0; rest &= rest - 1) {
        const int lane = __builtin_ctz(rest);
        if (const SurfaceLook* const look = frame.surfaces[met[lane]].look)
            lanes[lane] = emitterBrightness(look->numbers.emission);
    }
    return preference;
}

/// How densely rays are sent to surfaces that were met, by solid angle.
inline Lanes emitterDensity(const RenderSetup& setup, const RayPacket& packet,
                            const SurfaceLanes& surfaces, const LaneMask& shining) {
    const LaneVectors way = packet.direction();
    const Lanes length = squareRoot(dot(way, way));
    const Lanes cosine = magnitude(dot(surfaces.face, way)) / greatest(length, least_length);
    const Lanes distance = packet.distance * length;
    const Lanes by_area =
        preferenceOf(setup.frame, surfaces, shining) * setup.emitters.density_of_brightness;
    return select(shining, by_area * distance * distance / greatest(cosine, 1e-4F), 0.0F);
}

/// The first triangle at which the growing chances are above `wanted`.
inline const Emitter& emitterAt(const EmitterTable& table, float wanted) {
    int low = 0;
    int high = table.count - 1;
    while (low < high) {
        const int middle = (low + high) / 2;
        if (table.ends[middle] > wanted)
            high = middle;
        else
            low = middle + 1;
    }
    return table.emitters[low];
}

/// Places on emitters, one for each lane.
struct EmitterPlaces {
    LaneVectors place;
    LaneVectors normal; ///< of unit length, to one side or the other
    Lanes density;      ///< by area
};

/// @param choice  of triangles, 0 to 1
inline EmitterPlaces placesOnEmitters(const RenderSetup& setup, const Lanes& choice,
                                      const LanePlaces& place) {
    EmitterPlaces result;
    auto* const to = reinterpret_cast<float*>(&result);
    for (int lane = 0; lane < lane_count; ++lane) {
        const Emitter& emitter = emitterAt(setup.emitters, laneOf(choice, lane));
        // Folds the unit square into the triangle (M. Pharr and others, 2016, 13.6.5).
        const float root = __builtin_sqrtf(laneOf(place.u, lane));
        const float a = 1.0F - root;
        const float b = laneOf(place.v, lane) * root;
        for (int axis = 0; axis < 3; ++axis) {
            to[axis * lane_count + lane] =
                emitter.corner[axis] + a * emitter.edges[0][axis] + b * emitter.edges[1][axis];
            to[(3 + axis) * lane_count + lane] = emitter.normal[axis];
        }
        to[6 * lane_count + lane] = emitter.density;
    }
    return result;
}

/// How near two surfaces must lie to be one, as a part of the way to them.
constexpr float same_place = 1e-3F;

/// The light that rays find which end at places on emitters.
inline LaneColors shiningAt(const RenderSetup& setup, const LaneVectors& from,
                            const LaneVectors& toward, const LaneMask& wanted) {
    const FrameSetup& frame = setup.bounce;
    RayPacket rays;
    prepare(rays.rays.ray);
    rays.x = rays.y = 0.0F;
    setOrigin(rays.rays.ray, along(from, toward, 1.0F - same_place));
    setDirection(rays.rays.ray, toward);
    rays.active = wanted;
    intersect(frame, rays, RTC_INTERSECT_CONTEXT_FLAG_INCOHERENT);
    rays.hit = rays.hit & (rays.distance < 2.0F * same_place);
    LaneColors shining{0.0F, 0.0F, 0.0F};
    if (!any(rays.hit))
        return shining;
    SurfaceLanes met;
    readSurfaces(frame, rays, met);
    LookLanes looks;
    if (!readLooks(frame, rays, met, looks))
        return shining;
    return select(rays.hit, emissionOf(frame, looks.numbers), shining);
}

} // namespace
} // namespace quarn
