#pragma once

#include <embree3/rtcore.h>

#include <cstdint>

namespace quarn {

class DisplayScene;
struct RaySurface;

/// The context of rays to which glass is not there: a surface whose base colour, texture and vertex
/// colours together are less than half opaque at the place, or whose material transmits more than
/// half of the light. All other see-through surfaces stop them; where a cut-out leaves a hole they
/// pass.
struct GlassFilter {
    /// @param fronts_alone  the backs of one-sided surfaces are not there either
    /// @param absent  a surface of the ray scene that is not there at all
    GlassFilter(const DisplayScene& scene, bool fronts_alone, std::uint32_t absent = NO_SURFACE);

    RTCIntersectContext context; ///< first: rays are shot with its address
    const RaySurface* surfaces;
    const std::uint32_t* first_surfaces; ///< by instance; null when the scene has none
    std::uint32_t sole_first_surface;    ///< then
    bool passes_backs;
    std::uint32_t absent_surface = NO_SURFACE; ///< of the ray scene; is not there either

    static constexpr std::uint32_t NO_SURFACE = ~0U;
};

} // namespace quarn
