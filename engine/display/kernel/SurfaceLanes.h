#pragma once

#include "engine/display/SurfacePlace.h"
#include "engine/display/kernel/RayPacket.h"
#include "engine/display/kernel/SurfacePaint.h"

namespace quarn {
namespace {

/// The surfaces that a packet met.
struct SurfaceLanes {
    /// Normals of the triangles, toward the observer; of unit length if the frame needs it.
    LaneVectors face;
    LaneVectors normal; ///< unit normals for shading, on the same side
    LaneColors albedo;
    LaneInts surface; ///< index into FrameSetup::surfaces; 0 for rays that met none
};

inline LaneInts surfacesMet(const FrameSetup& frame, const RayPacket& packet) {
    const LaneInts geometry = load(packet.rays.hit.geomID);
    if (!frame.first_surfaces)
        return select(packet.hit, geometry + LaneInts(frame.sole_first_surface), LaneInts(0));
    const LaneInts instance = select(packet.hit, load(packet.rays.hit.instID[0]), LaneInts(0));
    return select(packet.hit, geometry + gathered(frame.first_surfaces, instance), LaneInts(0));
}

inline LaneVectors turned(const float (&m)[3][3], const LaneVectors& v) {
    return {v.x * m[0][0] + v.y * m[0][1] + v.z * m[0][2],
            v.x * m[1][0] + v.y * m[1][1] + v.z * m[1][2],
            v.x * m[2][0] + v.y * m[2][1] + v.z * m[2][2]};
}

/// The geometric normals in the coordinates of the meshes; upright where nothing was met. They are
/// as long as areas, so they are measured by the scene's size: the squares of their lengths must
/// neither overflow for a planet nor vanish for a grain.
inline LaneVectors geometricNormals(const FrameSetup& frame, const RayPacket& packet) {
    const RTCHit16& hit = packet.rays.hit;
    const float size = frame.scene_size > 1e-15F ? frame.scene_size : 1e-15F;
    const Lanes scale = 1.0F / (size * size);
    const LaneVectors straight_up{0.0F, 0.0F, 1.0F};
    return select(
        packet.hit,
        LaneVectors{load(hit.Ng_x) * scale, load(hit.Ng_y) * scale, load(hit.Ng_z) * scale},
        straight_up);
}

/// Squares of less are no floats: a shorter vector stays short, and never becomes a long one.
constexpr float least_length = 1e-19F;

inline LaneVectors ofUnitLength(const LaneVectors& v) {
    return v * (Lanes(1.0F) / greatest(squareRoot(dot(v, v)), least_length));
}

/// The normals, turned toward the observer.
inline LaneVectors towardObserver(const FrameSetup& frame, const RayPacket& packet,
                                  const LaneVectors& normal) {
    const Lanes turn = select(dot(normal, packet.direction()) > 0.0F, -1.0F, 1.0F);
    if (!frame.needs_unit_faces)
        return normal * turn;
    return normal * (turn / greatest(squareRoot(dot(normal, normal)), least_length));
}

/// The direction that packNormal stored, some 32767 long.
inline LaneVectors unpacked(const LaneInts& packed) {
    const Lanes u = floatsOf(shiftedRight(shiftedLeft(packed, 16), 16));
    const Lanes v = floatsOf(shiftedRight(packed, 16));
    const Lanes below = magnitude(u) + magnitude(v) - 32767.0F;
    const Lanes fold = greatest(below, 0.0F);
    return {u - withSignOf(fold, u), v - withSignOf(fold, v), -below};
}

/// Interpolates the corner normals of one surface; only the lanes of `mask` come out right.
inline LaneVectors smoothNormals(const RaySurface& surface, const RayPacket& packet,
                                 const LaneMask& mask, const LaneVectors& face) {
    const RTCHit16& hit = packet.rays.hit;
    const LaneInts first = select(mask, load(hit.primID), LaneInts(0)) * LaneInts(3);
    const LaneVectors a = unpacked(gathered(surface.corner_normals, first));
    const LaneVectors b = unpacked(gathered(surface.corner_normals + 1, first));
    const LaneVectors c = unpacked(gathered(surface.corner_normals + 2, first));
    const Lanes u = load(hit.u);
    const Lanes v = load(hit.v);
    const Lanes w = Lanes(1.0F) - u - v;
    LaneVectors sum{w * a.x + u * b.x + v * c.x, w * a.y + u * b.y + v * c.y,
                    w * a.z + u * b.z + v * c.z};
    if (surface.place)
        sum = turned(surface.place->cofactors, sum);
    return sum * withSignOf(inverseRoot(dot(sum, sum)), dot(sum, face));
}

/// Multiplies the albedo of the lanes by vertex colours and texture.
inline void paintLanes(const FrameSetup& frame, const RaySurface& surface, const RayPacket& packet,
                       unsigned lanes_meant, SurfaceLanes& lanes) {
    float* const albedo[3] = {reinterpret_cast<float*>(lanes.albedo.r.part),
                              reinterpret_cast<float*>(lanes.albedo.g.part),
                              reinterpret_cast<float*>(lanes.albedo.b.part)};
    for (int i = 0; i < lane_count; ++i) {
        if (!(lanes_meant >> i & 1U))
            continue;
        const float paint_place[3] = {packet.rays.hit.u[i], packet.rays.hit.v[i],
                                      packet.rays.ray.tfar[i]};
        float color[3] = {1.0F, 1.0F, 1.0F};
        paintAt(frame, surface, packet.rays, i, paint_place, color);
        for (int c = 0; c < 3; ++c)
            albedo[c][i] *= color[c];
    }
}

inline void readSurface(const FrameSetup& frame, const RaySurface& surface, const RayPacket& packet,
                        const LaneMask& mask, SurfaceLanes& lanes) {
    if (surface.place) {
        const LaneVectors normal =
            turned(surface.place->cofactors, geometricNormals(frame, packet)) *
            surface.place->area_scale;
        lanes.face = select(mask, towardObserver(frame, packet, normal), lanes.face);
    }
    if (surface.corner_normals)
        lanes.normal = select(mask, smoothNormals(surface, packet, mask, lanes.face), lanes.normal);
    else if (frame.needs_unit_faces)
        lanes.normal = select(mask, lanes.face, lanes.normal);
    else
        lanes.normal = select(mask, ofUnitLength(lanes.face), lanes.normal);
    if (!frame.base_colors)
        return;
    lanes.albedo = select(mask, uniformColor(surface.albedo), lanes.albedo);
    if (frame.textures && (surface.colors || surface.texture))
        paintLanes(frame, surface, packet, bits(mask), lanes);
}

/// Fills `lanes` for all rays that hit something. Most packets meet one surface only.
[[gnu::always_inline]] inline void readSurfaces(const FrameSetup& frame, const RayPacket& packet,
                                                SurfaceLanes& lanes) {
    lanes.surface = surfacesMet(frame, packet);
    lanes.face = towardObserver(frame, packet, geometricNormals(frame, packet));
    lanes.normal = {0.0F, 0.0F, 1.0F};
    lanes.albedo = uniformColor(frame.plain_albedo);
    alignas(64) std::uint32_t surfaces[lane_count];
    store(surfaces, lanes.surface);
    unsigned rest = bits(packet.hit);
    while (rest != 0) {
        const std::uint32_t surface = surfaces[__builtin_ctz(rest)];
        const LaneMask mask =
            packet.hit & (lanes.surface == LaneInts(static_cast<std::int32_t>(surface)));
        rest &= ~bits(mask);
        readSurface(frame, frame.surfaces[surface], packet, mask, lanes);
    }
}

} // namespace
} // namespace quarn
