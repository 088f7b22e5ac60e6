#pragma once

#include "ground/Result.h"
#include "kelmar/KM_Viewport.h"

namespace quarn {

class ObjectTable;

/// How a camera is to be fitted to what is visible.
struct ViewFit {
    /// Fit for every direction of a full turn about the vertical through the target.
    bool turn = false;
    /// Keep the viewport's target point; else the middle of the visible objects' box becomes it,
    /// for a turn in perspective raised or lowered so that the picture is filled evenly.
    bool keep_target = false;
    /// Distance of the camera from the target as a multiple of the fitted one, above 0; in a
    /// parallel projection the extent of the picture instead.
    double distance = 1.0;
};

/// The camera moved along its direction, with a level horizon, to where everything visible just
/// fills the picture: what reaches out farthest comes to 95 % of the way from the middle of the
/// picture to its border. Measured are the corners of meshes, curves and points themselves, not
/// their box, so that no shape is shown smaller than need be.
/// @return the viewport; an error when nothing is visible, or the objects are too small or too far
///         from the origin for a camera to stand before them
Result<KM_Viewport> fitViewport(const KM_Viewport& viewport, const ObjectTable& objects,
                                const ViewFit& fit);

} // namespace quarn
