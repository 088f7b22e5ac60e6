#pragma once

#include "engine/sunhours/SurfacePoints.h"
#include "ground/Result.h"
#include "kelmar/KM_Point.h"

namespace quarn {

class DisplayScene;

/// All surfaces that are shown, cut into small triangles.
struct SurfaceGrid {
    SurfacePoints points;            ///< the middle of each triangle
    std::vector<KM_3fPoint> corners; ///< three of each, in the coordinates of the scene's rays
};

inline constexpr std::size_t most_grid_triangles = 8'000'000;

/// Cuts each triangle into equal ones like it until no edge is longer than `size`. Surfaces that
/// are seen from both sides mean both.
/// @return an error where there would be more than most_grid_triangles
Result<SurfaceGrid> gridOfSurfaces(const DisplayScene& scene, double size);

} // namespace quarn
