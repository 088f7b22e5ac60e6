#include "engine/display/kernel/SurfacePaint.h"

#include "engine/display/MipTexture.h"
#include "engine/display/SurfacePlace.h"
#include "kelmar/KM_Mesh.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

float length(float x, float y, float z) {
    return std::sqrt(x * x + y * y + z * z);
}

/// How many texels a pixel covers, as the level of the halved textures: from the area of the
/// triangle in the world and on the texture, and the area of a pixel there.
float textureLevel(const FrameSetup& frame, const RaySurface& surface, const RTCRayHit16& rays,
                   int lane, float distance) {
    const RTCHit16& hit = rays.hit;
    const RTCRay16& ray = rays.ray;
    const std::uint32_t* const vertex = surface.triangles[hit.primID[lane]].vi;
    const KM_2fPoint& a = surface.texture_coordinates[vertex[0]];
    const KM_2fPoint& b = surface.texture_coordinates[vertex[1]];
    const KM_2fPoint& c = surface.texture_coordinates[vertex[2]];
    const float texels = std::fabs((b.x - a.x) * (c.y - a.y) - (c.x - a.x) * (b.y - a.y)) *
                         static_cast<float>(surface.texture->width()) *
                         static_cast<float>(surface.texture->height());
    // As areas of the scene's own size, whose squares are no trouble to compute.
    const float size = std::max(frame.scene_size, 1e-15F);
    const float scale = 1.0F / (size * size);
    float normal[3] = {hit.Ng_x[lane] * scale, hit.Ng_y[lane] * scale, hit.Ng_z[lane] * scale};
    if (surface.place) {
        turn(surface.place->cofactors, {normal[0], normal[1], normal[2]}, normal);
        for (float& coordinate : normal)
            coordinate *= surface.place->area_scale;
    }
    const float world = length(normal[0], normal[1], normal[2]);
    const float side = frame.rays.pixel_size * (frame.rays.parallel ? 1.0F : distance);
    const float facing =
        std::fabs(normal[0] * ray.dir_x[lane] + normal[1] * ray.dir_y[lane] +
                  normal[2] * ray.dir_z[lane]) /
        std::max(world * length(ray.dir_x[lane], ray.dir_y[lane], ray.dir_z[lane]), 1e-30F);
    const float covered = side / size * (side / size) / std::max(facing, 0.02F);
    const float ratio = texels * covered / std::max(world, 1e-30F);
    return ratio > 1.0F ? 0.5F * std::log2(ratio) : 0.0F;
}

TextureSample textureAt(const FrameSetup& frame, const RaySurface& surface, const RTCRayHit16& rays,
                        int lane, const float (&place)[3]) {
    const std::uint32_t* const vertex = surface.triangles[rays.hit.primID[lane]].vi;
    const float weight[3] = {1.0F - place[0] - place[1], place[0], place[1]};
    float u = 0.0F;
    float v = 0.0F;
    for (int corner = 0; corner < 3; ++corner) {
        u += weight[corner] * surface.texture_coordinates[vertex[corner]].x;
        v += weight[corner] * surface.texture_coordinates[vertex[corner]].y;
    }
    return surface.texture->sample(u, v, textureLevel(frame, surface, rays, lane, place[2]));
}

void multiplyVertexColor(const RaySurface& surface, const std::uint32_t* vertex,
                         const float (&weight)[3], float (&color)[3]) {
    LinearColor mean;
    for (int corner = 0; corner < 3; ++corner) {
        const LinearColor c = linearFromColor(surface.colors[vertex[corner]]);
        mean.r += weight[corner] * c.r;
        mean.g += weight[corner] * c.g;
        mean.b += weight[corner] * c.b;
    }
    color[0] *= mean.r;
    color[1] *= mean.g;
    color[2] *= mean.b;
}

} // namespace

float paneOpacityAt(const FrameSetup& frame, const RaySurface& surface, const RTCRayHit16& rays,
                    int lane, const float (&place)[3]) {
    const std::uint32_t* const vertex = surface.triangles[rays.hit.primID[lane]].vi;
    const float weight[3] = {1.0F - place[0] - place[1], place[0], place[1]};
    float opacity = surface.opacity;
    if (surface.colors) {
        float alpha = 0.0F;
        for (int corner = 0; corner < 3; ++corner)
            alpha += weight[corner] * static_cast<float>(surface.colors[vertex[corner]].a);
        opacity *= alpha / 255.0F;
    }
    if (surface.texture)
        opacity *= textureAt(frame, surface, rays, lane, place).alpha;
    return opacity;
}

void paintAt(const FrameSetup& frame, const RaySurface& surface, const RTCRayHit16& rays, int lane,
             const float (&place)[3], float (&color)[3]) {
    const std::uint32_t* const vertex = surface.triangles[rays.hit.primID[lane]].vi;
    const float weight[3] = {1.0F - place[0] - place[1], place[0], place[1]};
    if (surface.colors)
        multiplyVertexColor(surface, vertex, weight, color);
    if (!surface.texture)
        return;
    const TextureSample sample = textureAt(frame, surface, rays, lane, place);
    color[0] *= sample.color.r;
    color[1] *= sample.color.g;
    color[2] *= sample.color.b;
}

} // namespace quarn
