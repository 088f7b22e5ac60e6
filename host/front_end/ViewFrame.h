#pragma once

#include "sdk/qncore/QnExport.h"

class CQuarnDoc;
class CQuarnView;

namespace quarn {

/// Sets the size of a view's frame, which is the size of its pictures, also of recorded ones. The
/// camera gets its aspect, so that nothing is stretched. What the view showed is gone until the
/// next redraw.
/// @return false, with nothing changed, unless both sides are from 1 to 16384 pixels
QNCORE_API bool setFrameSize(CQuarnView& view, int width_px, int height_px);

/// Makes a view the active one of its document.
QNCORE_API void activateView(CQuarnView& view);

/// The active view of a document. Valid until the view closes.
QNCORE_API CQuarnView& activeView(CQuarnDoc& document);

} // namespace quarn
