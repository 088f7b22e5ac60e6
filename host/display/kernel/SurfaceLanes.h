#pragma once

#include "host/display/MipTexture.h"
#include "host/display/kernel/RayPacket.h"
#include "kelmar/KM_Mesh.h"

namespace quarn {
namespace {

/// The surfaces that a packet met.
struct SurfaceLanes {
    LaneVectors face;   ///< unit normals of the triangles, toward the observer
    LaneVectors normal; ///< unit normals for shading, on the same side
    LaneColors albedo;
    std::uint32_t surface[lane_count]; ///< index into FrameSetup::surfaces
};

inline void findSurfaces(const FrameSetup& frame, const RayPacket& packet, SurfaceLanes& lanes) {
    const RTCHit16& hit = packet.rays.hit;
    for (int i = 0; i < lane_count; ++i) {
        std::uint32_t first = frame.sole_first_surface;
        if (packet.hit.v[i] && hit.instID[0][i] != RTC_INVALID_GEOMETRY_ID)
            first = frame.first_surfaces[hit.instID[0][i]];
        lanes.surface[i] = packet.hit.v[i] ? first + hit.geomID[i] : 0;
    }
}

/// Turns the geometric normals toward the observer and gives them unit length.
inline void faceNormals(const RayPacket& packet, LaneVectors& face) {
    const RTCRay16& ray = packet.rays.ray;
    const RTCHit16& hit = packet.rays.hit;
    for (int i = 0; i < lane_count; ++i) {
        const float x = packet.hit.v[i] ? hit.Ng_x[i] : 0.0F;
        const float y = packet.hit.v[i] ? hit.Ng_y[i] : 0.0F;
        const float z = packet.hit.v[i] ? hit.Ng_z[i] : 1.0F;
        const float length = squareRoot(x * x + y * y + z * z);
        const float along = x * ray.dir_x[i] + y * ray.dir_y[i] + z * ray.dir_z[i];
        const float scale = (along > 0.0F ? -1.0F : 1.0F) / greatest(length, 1e-30F);
        face.x.v[i] = x * scale;
        face.y.v[i] = y * scale;
        face.z.v[i] = z * scale;
    }
}

struct Vector {
    float x;
    float y;
    float z;
};

/// The direction that packNormal stored, not of unit length.
inline Vector unpacked(std::uint32_t packed) {
    const auto bits = static_cast<std::int32_t>(packed);
    const float u = static_cast<float>((bits << 16) >> 16) * (1.0F / 32767.0F);
    const float v = static_cast<float>(bits >> 16) * (1.0F / 32767.0F);
    const float z = 1.0F - absolute(u) - absolute(v);
    const float fold = least(z, 0.0F);
    return {u + (u < 0.0F ? -fold : fold), v + (v < 0.0F ? -fold : fold), z};
}

/// Interpolates the corner normals of one surface in the lanes of `mask`.
inline void smoothNormals(const RaySurface& surface, const RayPacket& packet, const LaneMask& mask,
                          SurfaceLanes& lanes) {
    const RTCHit16& hit = packet.rays.hit;
    alignas(64) std::uint32_t corner[3][lane_count];
    for (int i = 0; i < lane_count; ++i) {
        const std::uint32_t triangle = mask.v[i] ? hit.primID[i] : 0;
        const std::uint32_t* const normals = surface.corner_normals + std::size_t{3} * triangle;
        corner[0][i] = normals[0];
        corner[1][i] = normals[1];
        corner[2][i] = normals[2];
    }
    for (int i = 0; i < lane_count; ++i) {
        const Vector a = unpacked(corner[0][i]);
        const Vector b = unpacked(corner[1][i]);
        const Vector c = unpacked(corner[2][i]);
        const float u = hit.u[i];
        const float v = hit.v[i];
        const float w = 1.0F - u - v;
        const float x = w * a.x + u * b.x + v * c.x;
        const float y = w * a.y + u * b.y + v * c.y;
        const float z = w * a.z + u * b.z + v * c.z;
        const float length = squareRoot(x * x + y * y + z * z);
        const float outward = x * lanes.face.x.v[i] + y * lanes.face.y.v[i] + z * lanes.face.z.v[i];
        const float scale = (outward < 0.0F ? -1.0F : 1.0F) / greatest(length, 1e-30F);
        const bool meant = mask.v[i] != 0;
        lanes.normal.x.v[i] = meant ? x * scale : lanes.normal.x.v[i];
        lanes.normal.y.v[i] = meant ? y * scale : lanes.normal.y.v[i];
        lanes.normal.z.v[i] = meant ? z * scale : lanes.normal.z.v[i];
    }
}

/// How many texels a pixel covers, as the level of the halved textures: from the area of the
/// triangle in the world and on the texture, and the area of a pixel there.
inline float textureLevel(const FrameSetup& frame, const RaySurface& surface,
                          const RayPacket& packet, const SurfaceLanes& lanes, int i) {
    const RTCHit16& hit = packet.rays.hit;
    const RTCRay16& ray = packet.rays.ray;
    const std::uint32_t* const vertex = surface.triangles[hit.primID[i]].vi;
    const KM_2fPoint& a = surface.texture_coordinates[vertex[0]];
    const KM_2fPoint& b = surface.texture_coordinates[vertex[1]];
    const KM_2fPoint& c = surface.texture_coordinates[vertex[2]];
    const float texels = absolute((b.x - a.x) * (c.y - a.y) - (c.x - a.x) * (b.y - a.y)) *
                         static_cast<float>(surface.texture->width()) *
                         static_cast<float>(surface.texture->height());
    const float world = squareRoot(hit.Ng_x[i] * hit.Ng_x[i] + hit.Ng_y[i] * hit.Ng_y[i] +
                                   hit.Ng_z[i] * hit.Ng_z[i]);
    const float side = frame.rays.pixel_size * (frame.rays.parallel ? 1.0F : ray.tfar[i]);
    const float length = squareRoot(ray.dir_x[i] * ray.dir_x[i] + ray.dir_y[i] * ray.dir_y[i] +
                                    ray.dir_z[i] * ray.dir_z[i]);
    const float facing =
        absolute(lanes.face.x.v[i] * ray.dir_x[i] + lanes.face.y.v[i] * ray.dir_y[i] +
                 lanes.face.z.v[i] * ray.dir_z[i]) /
        length;
    const float covered = side * side / greatest(facing, 0.1F);
    const float ratio = texels * covered / greatest(world, 1e-30F);
    return ratio > 1.0F ? 0.5F * __builtin_log2f(ratio) : 0.0F;
}

inline void multiplyVertexColor(const RaySurface& surface, const RayPacket& packet,
                                SurfaceLanes& lanes, int i) {
    const RTCHit16& hit = packet.rays.hit;
    const std::uint32_t* const vertex = surface.triangles[hit.primID[i]].vi;
    const float weight[3] = {1.0F - hit.u[i] - hit.v[i], hit.u[i], hit.v[i]};
    float color[3] = {0.0F, 0.0F, 0.0F};
    for (int corner = 0; corner < 3; ++corner) {
        const KM_Color& c = surface.colors[vertex[corner]];
        color[0] += weight[corner] * linearFromSrgbByte(c.r);
        color[1] += weight[corner] * linearFromSrgbByte(c.g);
        color[2] += weight[corner] * linearFromSrgbByte(c.b);
    }
    lanes.albedo.r.v[i] *= color[0];
    lanes.albedo.g.v[i] *= color[1];
    lanes.albedo.b.v[i] *= color[2];
}

inline void multiplyTexture(const FrameSetup& frame, const RaySurface& surface,
                            const RayPacket& packet, SurfaceLanes& lanes, int i) {
    const RTCHit16& hit = packet.rays.hit;
    const std::uint32_t* const vertex = surface.triangles[hit.primID[i]].vi;
    const KM_2fPoint* const place = surface.texture_coordinates;
    const float u = hit.u[i];
    const float v = hit.v[i];
    const float w = 1.0F - u - v;
    const TextureSample sample = surface.texture->sample(
        w * place[vertex[0]].x + u * place[vertex[1]].x + v * place[vertex[2]].x,
        w * place[vertex[0]].y + u * place[vertex[1]].y + v * place[vertex[2]].y,
        textureLevel(frame, surface, packet, lanes, i));
    lanes.albedo.r.v[i] *= sample.color.r;
    lanes.albedo.g.v[i] *= sample.color.g;
    lanes.albedo.b.v[i] *= sample.color.b;
}

inline void surfaceColors(const FrameSetup& frame, const RaySurface& surface,
                          const RayPacket& packet, const LaneMask& mask, SurfaceLanes& lanes) {
    const float* const albedo = frame.base_colors ? surface.albedo : frame.plain_albedo;
    for (int i = 0; i < lane_count; ++i) {
        lanes.albedo.r.v[i] = mask.v[i] ? albedo[0] : lanes.albedo.r.v[i];
        lanes.albedo.g.v[i] = mask.v[i] ? albedo[1] : lanes.albedo.g.v[i];
        lanes.albedo.b.v[i] = mask.v[i] ? albedo[2] : lanes.albedo.b.v[i];
    }
    if (!frame.base_colors || !frame.textures)
        return;
    for (int i = 0; i < lane_count; ++i) {
        if (mask.v[i] && surface.colors)
            multiplyVertexColor(surface, packet, lanes, i);
        if (mask.v[i] && surface.texture)
            multiplyTexture(frame, surface, packet, lanes, i);
    }
}

inline void readSurface(const FrameSetup& frame, const RaySurface& surface, const RayPacket& packet,
                        const LaneMask& mask, SurfaceLanes& lanes) {
    if (surface.corner_normals)
        smoothNormals(surface, packet, mask, lanes);
    surfaceColors(frame, surface, packet, mask, lanes);
}

/// Fills `lanes` for all rays that hit something. Most packets meet one surface only.
inline void readSurfaces(const FrameSetup& frame, const RayPacket& packet, SurfaceLanes& lanes) {
    findSurfaces(frame, packet, lanes);
    faceNormals(packet, lanes.face);
    lanes.normal = lanes.face;
    LaneMask rest = packet.hit;
    while (any(rest)) {
        int first = 0;
        while (!rest.v[first])
            ++first;
        const std::uint32_t surface = lanes.surface[first];
        LaneMask mask;
        for (int i = 0; i < lane_count; ++i) {
            mask.v[i] = lanes.surface[i] == surface ? rest.v[i] : 0;
            rest.v[i] = lanes.surface[i] == surface ? 0 : rest.v[i];
        }
        readSurface(frame, frame.surfaces[surface], packet, mask, lanes);
    }
}

} // namespace
} // namespace quarn
