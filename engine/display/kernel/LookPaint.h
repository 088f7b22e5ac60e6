#pragma once

#include "engine/display/kernel/FrameSetup.h"

namespace quarn {

struct SurfaceLook;

/// What a look's textures make of its numbers at one place.
struct PaintedLook {
    float emission[3];
    float metalness;
    float roughness;
};

/// Reads the textures of a surface's look where ray `lane` met it.
/// @param place    the hit's u and v and the distance along the ray
/// @param painted  holds the look's own numbers
void paintLookAt(const FrameSetup& frame, const RaySurface& surface, const RTCRayHit16& rays,
                 int lane, const float (&place)[3], PaintedLook& painted);

} // namespace quarn
