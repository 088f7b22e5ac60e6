#pragma once

#include <embree3/rtcore.h>

#include <cstdint>

namespace quarn {

struct RaySurface;

/// The context of rays that pass the backs of one-sided surfaces.
struct FrontsAlone {
    RTCIntersectContext context; ///< first: rays are shot with its address
    const RaySurface* surfaces;
    const std::uint32_t* first_surfaces; ///< by instance; null when the scene has none
    std::uint32_t sole_first_surface;    ///< then
};

/// Tells a new context to let rays pass backs.
void passBacks(FrontsAlone& fronts);

} // namespace quarn
