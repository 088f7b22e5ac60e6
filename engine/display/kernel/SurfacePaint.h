#pragma once

#include "engine/display/kernel/FrameSetup.h"

namespace quarn {

/// Multiplies `color` by the vertex colours and the texture of a surface where ray `lane` met it.
/// @param place  the hit's u and v and the distance along the ray
void paintAt(const FrameSetup& frame, const RaySurface& surface, const RTCRayHit16& rays, int lane,
             const float (&place)[3], float (&color)[3]);

/// How opaque a see-through surface is where ray `lane` met it, 0 to 1.
/// @param place  the hit's u and v and the distance along the ray
float paneOpacityAt(const FrameSetup& frame, const RaySurface& surface, const RTCRayHit16& rays,
                    int lane, const float (&place)[3]);

} // namespace quarn
