#pragma once

#include "engine/sunhours/SurfacePoints.h"

#include <cstddef>
#include <vector>

namespace quarn {

/// The points that speak for one object, each for the same area.
struct ObjectSpan {
    std::size_t mesh = 0;  ///< an index in DisplayScene::meshes
    std::size_t first = 0; ///< of its points
    std::size_t count = 0; ///< 0 where the object has no area
    double area = 0.0;     ///< in squares of the model's unit
};

struct ObjectPoints {
    SurfacePoints points;
    std::vector<ObjectSpan> objects; ///< those that are shown, in the order of the scene
};

/// Spreads points over the surfaces of the objects that are shown, evenly by area, the same at
/// every call. Surfaces that are seen from both sides mean both: the sun counts on either.
ObjectPoints spreadPoints(const DisplayScene& scene);

} // namespace quarn
