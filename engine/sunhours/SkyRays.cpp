#include "engine/sunhours/SkyRays.h"

#include "engine/display/DisplayScene.h"
#include "engine/display/FlushDenormals.h"

#include <limits>

namespace quarn {

namespace {

std::uint32_t surfaceOfMesh(const DisplayScene& scene, std::optional<std::size_t> mesh) {
    const std::size_t count = mesh ? scene.rays().surfaces().size() : 0;
    for (std::size_t surface = 0; surface < count; ++surface)
        if (scene.meshOfSurface(surface) == *mesh)
            return static_cast<std::uint32_t>(surface);
    return GlassFilter::NO_SURFACE;
}

} // namespace

SkyRays::SkyRays(const DisplayScene& scene, const KM_3dPoint& point,
                 std::optional<std::size_t> absent_mesh)
    : m_scene(scene.rays().root()), m_filter(scene, false, surfaceOfMesh(scene, absent_mesh)) {
    const KM_3dVector place = point - scene.origin();
    m_place[0] = static_cast<float>(place.x);
    m_place[1] = static_cast<float>(place.y);
    m_place[2] = static_cast<float>(place.z);
}

bool SkyRays::isHidden(const KM_3dVector& toward) {
    if (!m_scene)
        return false;
    RTCRay ray{};
    ray.org_x = m_place[0];
    ray.org_y = m_place[1];
    ray.org_z = m_place[2];
    ray.dir_x = static_cast<float>(toward.x);
    ray.dir_y = static_cast<float>(toward.y);
    ray.dir_z = static_cast<float>(toward.z);
    ray.tfar = std::numeric_limits<float>::max();
    ray.mask = ~0U;
    const FlushDenormals flushing;
    rtcOccluded1(m_scene, &m_filter.context, &ray);
    return ray.tfar < 0.0F;
}

} // namespace quarn
