#pragma once

#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_Curve.h"

/// Divides a curve into the places of a camera that flies along it and those that it looks at, one
/// step ahead. In a single frame it looks from the curve's start to its end.
///
/// @param curve          may be null
/// @param camera_points  filled anew; as target_points, of no use after a failure. They differ in
///                       number where the curve cannot be evaluated somewhere
/// @return false when there are none: no curve, no frames, or a curve that cannot be evaluated at
///         any step
bool GetFlythroughPoints(const KM_Curve* curve, int frame_count, KM_3dPointArray& camera_points,
                         KM_3dPointArray& target_points);
