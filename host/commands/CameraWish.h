#pragma once

#include "ground/Result.h"
#include "kelmar/KM_Viewport.h"

#include <optional>

namespace quarn {

constexpr double SHORTEST_LENS_MM = 1.0;
constexpr double LONGEST_LENS_MM = 10000.0;

/// What a person wants of the camera; what is not there stays as it is.
struct CameraWish {
    std::optional<KM_3dPoint> location;
    std::optional<KM_3dPoint> target;
    std::optional<double> lens_mm;
    bool parallel = false;
};

/// The target of a camera; where it has none, a point before it.
KM_3dPoint cameraTarget(const KM_Viewport& viewport);

/// Moves a camera, with a level horizon, and gives it its lens.
/// @return an error, with the viewport worth nothing, when the camera would stand at its target,
///         and for the lens of a parallel view
Result<void> fulfil(const CameraWish& wish, KM_Viewport& viewport);

} // namespace quarn
