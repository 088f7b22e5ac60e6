#include "engine/display/kernel/SurfacePaint.h"

#include "engine/display/kernel/TexturePlace.h"
#include "kelmar/KM_Mesh.h"

namespace quarn {

namespace {

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
        opacity *= TexturePlace(frame, surface, rays, lane, place).sample(*surface.texture).alpha;
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
    const TextureSample sample =
        TexturePlace(frame, surface, rays, lane, place).sample(*surface.texture);
    color[0] *= sample.color.r;
    color[1] *= sample.color.g;
    color[2] *= sample.color.b;
}

} // namespace quarn
