#pragma once

#include "engine/sunhours/PicturePoints.h"
#include "engine/sunhours/SunSampling.h"
#include "host/sunhours/SunMoments.h"
#include "kelmar/KM_Viewport.h"

#include <optional>

namespace quarn {

/// A picture's hours of sun.
struct SunHoursMap {
    int width_px = 0;
    int height_px = 0;
    PixelTiles tiles;
    PicturePoints seen; ///< at the middles of pixels, by tiles
    SunLight light;     ///< of these; with the steps where they are shown

    /// Hours of a day; not a number where no surface is seen.
    float hours(int x, int y) const;
    /// As PicturePoints has it.
    std::uint32_t object(int x, int y) const { return seen.object[tiles.indexOf(x, y)]; }
};

/// The directions of the sun at some moments.
std::vector<SunStep> stepsOf(const SunMoments& moments);

/// @return nothing where `watch` ended the work
std::optional<SunHoursMap> mapOf(const DisplayScene& scene, const KM_Viewport& viewport,
                                 const SunHoursRequest& request, const SunMoments& moments,
                                 const SunWatch& watch);

} // namespace quarn
