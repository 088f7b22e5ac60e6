#pragma once

#include "engine/display/RaySurface.h"

#include <embree3/rtcore.h>

namespace quarn {

/// Moves the origin of shadow ray `lane` from a facet to the smooth surface that its normals stand
/// for. A facet of a smooth surface that faces away from the sun shadows itself although the smooth
/// normal still faces the sun, which would draw the facets along the border of light (J. Hanika,
/// "Hacking the Shadow Terminator", Ray Tracing Gems II, chapter 4). Flat surfaces are left alone,
/// and so are those whose smooth surface lies on the other side: a ray must not leave a hollow body
/// through its own wall.
/// @param face  the facet's normal on the side from which the ray starts
void liftToSmoothSurface(const RaySurface& surface, const RTCHit16& hit, int lane,
                         const float (&face)[3], RTCRay16& ray);

} // namespace quarn
