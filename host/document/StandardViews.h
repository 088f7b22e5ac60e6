#pragma once

#include "kelmar/KM_Viewport.h"

#include <span>
#include <string_view>

namespace quarn {

/// A view direction that has a name of its own.
struct StandardView {
    const wchar_t* name; ///< English
    int text_id;         ///< of its name as a command option
    KM_ViewProjection projection;
    KM_3dVector direction_to_camera; ///< from the target, of any length
};

/// Top, Front, Right and Perspective: the views of a new document, in their order.
std::span<const StandardView> standardViews();

/// The viewport that looks along a standard direction at a target, with a 50 mm lens. In a parallel
/// projection things at the target are seen as large as that lens shows them.
/// @param distance  of the camera from the target, in model units, above 0
KM_Viewport standardViewport(const StandardView& view, const KM_3dPoint& target, double distance,
                             int width_px, int height_px);

/// A viewport turned to a standard direction: it looks at the target it had from the distance it
/// had, in a picture of the same size. Without a target it looks at the origin.
KM_Viewport turnedTo(const StandardView& view, const KM_Viewport& viewport);

} // namespace quarn
