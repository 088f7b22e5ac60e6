#pragma once

#include "sdk/qncore/QnExport.h"

class CQuarnDoc;
class CQuarnView;

namespace quarn {

// Views as a window shows them. A view that was closed is left alone: nothing happens to it. What
// happens while a command runs, also while it plays or records and lets the front end work on
// events, waits until the command has ended: a command goes on with the view that it began with,
// and all pictures of a recording have one size.

/// Sets the size of a view's frame, which is the size of its pictures, also of recorded ones. The
/// camera gets its aspect, so that nothing is stretched. What the view showed is gone until the
/// next redraw, unless it had that size already. While a command runs, the view gets the size given
/// last when the command has ended; whoever gave it draws the view then.
/// @return false, with nothing changed, unless both sides are from 1 to 16384 pixels; false for a
///         view that was closed
QNCORE_API bool setFrameSize(CQuarnView& view, int width_px, int height_px);

/// Makes a view the active one of its document; while a command runs, when it has ended.
QNCORE_API void activateView(CQuarnView& view);

/// The active view of a document. Valid until the view closes.
QNCORE_API CQuarnView& activeView(CQuarnDoc& document);

} // namespace quarn
