#include "host/display/kernel/ShadowTerminator.h"

#include "host/display/PackedNormal.h"
#include "kelmar/KM_Mesh.h"

#include <algorithm>

namespace quarn {

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
        unpackNormal(surface.corner_normals[3 * triangle + corner], n);
        const float square = n[0] * n[0] + n[1] * n[1] + n[2] * n[2];
        const float turn = n[0] * face[0] + n[1] * face[1] + n[2] * face[2] < 0.0F ? -1.0F : 1.0F;
        const float height =
            turn * ((place[0] - at.x) * n[0] + (place[1] - at.y) * n[1] + (place[2] - at.z) * n[2]);
        const float lift = -turn * weight[corner] * std::min(0.0F, height) / square;
        ray.org_x[lane] += lift * n[0];
        ray.org_y[lane] += lift * n[1];
        ray.org_z[lane] += lift * n[2];
    }
}

} // namespace quarn
