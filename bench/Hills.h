#pragma once

#include "engine/scene/SceneContent.h"
#include "kelmar/KM_Light.h"
#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Viewport.h"

#include <cmath>
#include <cstdint>
#include <memory>
#include <utility>

/// The landscape that the benchmarks draw, in as many triangles as they want.
namespace bench {

/// Hills of 2 * cells * cells triangles over a square of 100 by 100 around the origin.
inline std::shared_ptr<KM_Mesh> makeHills(int cells) {
    auto mesh = std::make_shared<KM_Mesh>();
    const auto side = static_cast<std::uint32_t>(cells + 1);
    mesh->m_V.reserve(std::size_t{side} * side + 1);
    mesh->m_F.reserve(std::size_t{2} * static_cast<std::size_t>(cells) *
                      static_cast<std::size_t>(cells));
    for (int j = 0; j <= cells; ++j)
        for (int i = 0; i <= cells; ++i) {
            const float x = 100.0F * static_cast<float>(i) / static_cast<float>(cells) - 50.0F;
            const float y = 100.0F * static_cast<float>(j) / static_cast<float>(cells) - 50.0F;
            mesh->m_V.emplace_back(x, y,
                                   4.0F * std::sin(0.2F * x) * std::cos(0.17F * y) +
                                       std::sin(0.9F * x + 0.7F * y));
        }
    for (std::uint32_t j = 0; j + 1 < side; ++j)
        for (std::uint32_t i = 0; i + 1 < side; ++i) {
            const std::uint32_t a = j * side + i;
            mesh->m_F.push_back({{a, a + 1, a + side + 1}});
            mesh->m_F.push_back({{a, a + side + 1, a + side}});
        }
    mesh->ComputeVertexNormals();
    mesh->PadForRayTracing();
    return mesh;
}

/// A camera above one side of the hills that sees them fill most of the picture.
inline KM_Viewport hillsView() {
    KM_Viewport viewport;
    const KM_3dPoint eye(0.0, -62.0, 34.0);
    viewport.SetCameraLocation(eye);
    viewport.SetCameraDirection(KM_3dPoint(0.0, -8.0, 0.0) - eye);
    viewport.SetCameraUp(KM_3dVector::ZAxis);
    viewport.SetCamera35mmLensLength(40.0);
    return viewport;
}

inline KM_Light afternoonSun() {
    KM_Light sun;
    sun.SetStyle(KM_LightStyle::world_directional);
    sun.SetDirection({0.5, 0.6, -0.7});
    return sun;
}

/// One mesh under that sun.
inline quarn::SceneContent sunlit(std::shared_ptr<const KM_Mesh> mesh) {
    quarn::SceneContent content;
    content.revision = 1;
    content.meshes.push_back({{std::move(mesh), nullptr, {}}, KM_CreateUuid()});
    content.lights.push_back(afternoonSun());
    return content;
}

} // namespace bench
