#pragma once

#include "kelmar/KM_Viewport.h"

namespace quarn {

/// Moves a camera to a place from which it looks at a target; the target point stays as it is.
/// @param level_horizon  up becomes the world's Z; when the camera looks along it, and when false,
///                       the old up is kept, turned with the direction where it cannot stay
/// @return false, with the viewport unchanged, when a point is not valid, the points coincide, or a
///         part of the camera that must change is locked
bool moveCamera(KM_Viewport& viewport, const KM_3dPoint& target, const KM_3dPoint& camera,
                bool level_horizon);

/// As CQuarnViewport::SetTargetAndCameraLocation, for a camera that no view has.
bool setTargetAndCamera(KM_Viewport& viewport, const KM_3dPoint& target, const KM_3dPoint& camera,
                        bool update_target, bool update_up);

} // namespace quarn
