#pragma once

#include "kelmar/KM_Point.h"
#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"

#include <optional>

class CQuarnView;

namespace quarn {

/// An object that a person pointed at.
struct PickedObject {
    KM_UUID id = KM_nil_uuid;
    KM_wString name;  ///< its name; its id as text where it has none: both answer an object prompt
    KM_3dPoint point; ///< where it was hit, in document units
    bool is_selected = false;
};

/// The visible object at a point of a view's picture: a curve or a point object within a few
/// pixels goes before the nearest surface. What a surface covers is hit only where the view's
/// display mode shows it all the same. Quick enough for every movement of the mouse, but for the
/// first call after objects were changed, which builds what the next picture needs.
/// @param x_px, y_px  from the upper left corner of the view's frame
QNCORE_API std::optional<PickedObject> objectAt(CQuarnView& view, double x_px, double y_px);

/// The point that a person means at a point of a view's picture where a command asks for one: on
/// the nearest surface; else on the ground, the plane Z = 0; in a parallel view along an axis on
/// the plane through the target across the view direction.
/// @return nothing where neither is met, as above the horizon
QNCORE_API std::optional<KM_3dPoint> pointAt(CQuarnView& view, double x_px, double y_px);

} // namespace quarn
