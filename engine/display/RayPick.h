#pragma once

#include "kelmar/KM_Point.h"

#include <cstddef>
#include <optional>

namespace quarn {

class DisplayScene;

/// A ray through a place of a picture.
struct PickRay {
    KM_3dPoint origin;
    KM_3dVector direction;     ///< of unit length
    bool is_parallel = false;  ///< sees what lies behind its origin too
    bool passes_backs = false; ///< of one-sided surfaces, as in the modes that show materials
};

/// Where a ray meets a surface first.
struct SurfaceHit {
    std::size_t mesh = 0; ///< an index in DisplayScene::meshes
    KM_3dPoint point; ///< in world coordinates, on the plane of the triangle in double precision
    double distance = 0.0; ///< from the ray's origin, negative behind it
};

/// The first visible surface on a ray. Where a cut-out leaves a hole, the ray passes.
/// @return nothing where the ray meets none
std::optional<SurfaceHit> firstSurface(const DisplayScene& scene, const PickRay& ray);

} // namespace quarn
