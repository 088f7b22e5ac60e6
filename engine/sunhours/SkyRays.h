#pragma once

#include "engine/sunhours/GlassFilter.h"
#include "kelmar/KM_Point.h"

#include <cstddef>
#include <optional>

namespace quarn {

/// Looks from a point of a scene toward the sky. To be used by one thread at a time, and not after
/// the scene is updated.
class SkyRays {
public:
    /// @param point        in the world
    /// @param absent_mesh  one that is not there; an index of DisplayScene::meshes
    SkyRays(const DisplayScene& scene, const KM_3dPoint& point,
            std::optional<std::size_t> absent_mesh);

    /// Whether a surface stands before a direction of the sky; glass is not there.
    bool isHidden(const KM_3dVector& toward);

private:
    RTCScene m_scene;
    float m_place[3];
    GlassFilter m_filter;
};

} // namespace quarn
