#include "engine/display/kernel/TexturePlace.h"

#include "engine/display/SurfacePlace.h"
#include "kelmar/KM_Mesh.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

float length(float x, float y, float z) {
    return std::sqrt(x * x + y * y + z * z);
}

} // namespace

TexturePlace::TexturePlace(const FrameSetup& frame, const RaySurface& surface,
                           const RTCRayHit16& rays, int lane, const float (&place)[3]) {
    const RTCHit16& hit = rays.hit;
    const RTCRay16& ray = rays.ray;
    const std::uint32_t* const vertex = surface.triangles[hit.primID[lane]].vi;
    const float weight[3] = {1.0F - place[0] - place[1], place[0], place[1]};
    for (int corner = 0; corner < 3; ++corner) {
        m_u += weight[corner] * surface.texture_coordinates[vertex[corner]].x;
        m_v += weight[corner] * surface.texture_coordinates[vertex[corner]].y;
    }
    const KM_2fPoint& a = surface.texture_coordinates[vertex[0]];
    const KM_2fPoint& b = surface.texture_coordinates[vertex[1]];
    const KM_2fPoint& c = surface.texture_coordinates[vertex[2]];
    m_texture_area = std::fabs((b.x - a.x) * (c.y - a.y) - (c.x - a.x) * (b.y - a.y));
    // As areas of the scene's own size, whose squares are no trouble to compute.
    const float size = std::max(frame.scene_size, 1e-15F);
    const float scale = 1.0F / (size * size);
    float normal[3] = {hit.Ng_x[lane] * scale, hit.Ng_y[lane] * scale, hit.Ng_z[lane] * scale};
    if (surface.place) {
        turn(surface.place->cofactors, {normal[0], normal[1], normal[2]}, normal);
        for (float& coordinate : normal)
            coordinate *= surface.place->area_scale;
    }
    m_world_area = length(normal[0], normal[1], normal[2]);
    const float side = frame.rays.pixel_size * (frame.rays.parallel ? 1.0F : place[2]);
    const float facing =
        std::fabs(normal[0] * ray.dir_x[lane] + normal[1] * ray.dir_y[lane] +
                  normal[2] * ray.dir_z[lane]) /
        std::max(m_world_area * length(ray.dir_x[lane], ray.dir_y[lane], ray.dir_z[lane]), 1e-30F);
    m_covered = side / size * (side / size) / std::max(facing, 0.02F);
}

/// How many texels a pixel covers, as the level of the halved textures.
float TexturePlace::levelOf(const MipTexture& texture, float area_scale) const {
    const float texels = m_texture_area * static_cast<float>(texture.width()) *
                         static_cast<float>(texture.height()) * area_scale;
    const float ratio = texels * m_covered / std::max(m_world_area, 1e-30F);
    return ratio > 1.0F ? 0.5F * std::log2(ratio) : 0.0F;
}

TextureSample TexturePlace::sample(const MipTexture& texture) const {
    return texture.sample(m_u, m_v, levelOf(texture, 1.0F));
}

TextureSample TexturePlace::sample(const LookTexture& texture) const {
    const auto moved = [&](const float(&row)[3]) { return row[0] * m_u + row[1] * m_v + row[2]; };
    const float area_scale = std::fabs(texture.u[0] * texture.v[1] - texture.u[1] * texture.v[0]);
    return texture.mips->sample(moved(texture.u), moved(texture.v),
                                levelOf(*texture.mips, area_scale));
}

} // namespace quarn
