#include "engine/display/kernel/ShadowTerminator.h"

#include "engine/display/PackedNormal.h"
#include "engine/display/SurfacePlace.h"
#include "kelmar/KM_Mesh.h"

#include <algorithm>

namespace quarn {

namespace {

/// A packed normal and an offset of a mesh in the coordinates of the frame.
void standing(const RaySurface& surface, std::uint32_t packed_normal, const float (&offset)[3],
              float (&normal_there)[3], float (&offset_there)[3]) {
    float normal[3];
    unpackNormal(packed_normal, normal);
    if (surface.place) {
        turn(surface.place->cofactors, normal, normal_there);
        turn(surface.place->linear, offset, offset_there);
        return;
    }
    std::copy_n(normal, 3, normal_there);
    std::copy_n(offset, 3, offset_there);
}

} // namespace

void liftToSmoothSurface(const RaySurface& surface, const RTCHit16& hit, int lane,
                         const float (&face)[3], RTCRay16& ray) {
    if (!surface.corner_normals)
        return;
    const std::size_t triangle = hit.primID[lane];
    const std::uint32_t* const vertex = surface.triangles[triangle].vi;
    const float weight[3] = {1.0F - hit.u[lane] - hit.v[lane], hit.u[lane], hit.v[lane]};
    float place[3] = {0.0F, 0.0F, 0.0F};
    for (int corner = 0; corner < 3; ++corner) {
        const KM_3fPoint& at = surface.vertices[vertex[corner]];
        place[0] += weight[corner] * at.x;
        place[1] += weight[corner] * at.y;
        place[2] += weight[corner] * at.z;
    }
    for (std::size_t corner = 0; corner < 3; ++corner) {
        const KM_3fPoint& at = surface.vertices[vertex[corner]];
        float n[3];
        float from_vertex[3];
        standing(surface, surface.corner_normals[3 * triangle + corner],
                 {place[0] - at.x, place[1] - at.y, place[2] - at.z}, n, from_vertex);
        const float square = n[0] * n[0] + n[1] * n[1] + n[2] * n[2];
        const float side = n[0] * face[0] + n[1] * face[1] + n[2] * face[2] < 0.0F ? -1.0F : 1.0F;
        const float height =
            side * (from_vertex[0] * n[0] + from_vertex[1] * n[1] + from_vertex[2] * n[2]);
        const float lift = -side * weight[corner] * std::min(0.0F, height) / square;
        ray.org_x[lane] += lift * n[0];
        ray.org_y[lane] += lift * n[1];
        ray.org_z[lane] += lift * n[2];
    }
}

} // namespace quarn
