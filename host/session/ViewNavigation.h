#pragma once

#include "sdk/qncore/QnExport.h"

class CQuarnView;

namespace quarn {

// How the mouse moves the camera of a view. Distances are pixels of the view's frame, x to the
// right and y down; all points of the view's picture keep under the mouse as far as the movement
// allows. None of it draws the view. While a command runs, also while it waits for an answer, the
// camera may be moved; while one plays or records, whoever calls has to leave it alone: a frame
// that is shown sets its view's camera anew. A view that was closed, a camera that is locked and a
// distance that is not finite stay as they are.

/// Turns the camera about its target: a whole width of the frame is half a turn about the vertical,
/// a whole height half a turn over the top; the model follows the mouse. The horizon stays level,
/// and the camera stops a tenth of a degree short of the vertical above and below the target. A
/// plan view (parallel, along an axis) stays one: it is moved instead, as by panView.
QNCORE_API void orbitView(CQuarnView& view, double right_px, double down_px);

/// Moves camera and target in the picture's plane, so that what is at the target's depth stays
/// under the mouse.
QNCORE_API void panView(CQuarnView& view, double right_px, double down_px);

/// Moves the camera nearer to its target, or enlarges a parallel picture, about the point of the
/// picture that the mouse is on. It ends where a camera would lose its digits: at a ten-millionth
/// of the target's largest coordinate. The near plane stays at a thousandth of the target's
/// distance.
/// @param factor      above 1 makes things larger; one that is not above 0, or not finite, does
///                    nothing
/// @param x_px, y_px  the point that keeps its place, from the frame's upper left corner
QNCORE_API void zoomView(CQuarnView& view, double factor, double x_px, double y_px);

} // namespace quarn
