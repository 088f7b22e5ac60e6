#pragma once

#include <embree3/rtcore.h>

namespace quarn {

struct RaySurface;

/// The context of occlusion rays that see-through surfaces only dim. Such a ray's id is its place
/// in `passed` plus one; for rays of id 0, and of an id beyond, these surfaces are like others.
struct PassingLight {
    static constexpr unsigned count = 16;
    RTCIntersectContext context; ///< first: rays are shot with its address
    float passed[count];         ///< what comes through, to begin with 1
};

/// Makes a geometry let rays pass where its surface has a cut-out or is see-through.
/// @param surface  has to stay where it is while the geometry lives
/// @return false for a surface that stops all rays, whose geometry needs nothing
bool setOpacityFilter(RTCGeometry geometry, const RaySurface& surface);

/// How opaque a surface is at a place of one of its triangles, by full size textures.
float opacityAt(const RaySurface& surface, unsigned triangle, float u, float v);

} // namespace quarn
