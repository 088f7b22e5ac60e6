#pragma once

#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Viewport.h"

namespace quarn {

/// A parallel view straight from above with the Y axis up, which a box just fits into.
KM_Viewport planView(const KM_BoundingBox& box, int width_px, int height_px);

} // namespace quarn
