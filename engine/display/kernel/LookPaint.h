#pragma once

#include "engine/display/SurfaceLook.h"
#include "engine/display/kernel/FrameSetup.h"

namespace quarn {

/// A look at one place of a surface.
struct PaintedLook {
    LookNumbers<float> numbers;
    float normal[3]; ///< unit vector, toward the observer
    float coat_normal[3];
};

/// Reads the textures of a surface's look where ray `lane` met it.
/// @param place    the hit's u and v and the distance along the ray
/// @param painted  holds the look's own numbers and normals without their maps
void paintLookAt(const FrameSetup& frame, const RaySurface& surface, const RTCRayHit16& rays,
                 int lane, const float (&place)[3], PaintedLook& painted);

} // namespace quarn
