#pragma once

#include <embree3/rtcore.h>

namespace quarn {

/// Lets rays pass where a surface is less opaque than its cut-off. The geometry's user pointer
/// must be the RaySurface, which has to stay where it is while the geometry lives.
void setAlphaCutout(RTCGeometry geometry);

} // namespace quarn
