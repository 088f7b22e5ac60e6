#pragma once

#include "engine/sunhours/SunStep.h"
#include "engine/sunhours/SurfacePoints.h"

#include <cstdint>
#include <functional>
#include <span>
#include <vector>

namespace quarn {

class DisplayScene;

/// How much sun points get.
struct SunLight {
    std::vector<float> hours; ///< by point
    /// At which steps the sun reaches a point, where that was asked for: a bit for each point of a
    /// packet, packet by packet and step by step.
    std::vector<std::uint16_t> lit;
    std::size_t packets = 0; ///< of a step

    bool isLit(std::size_t step, std::size_t point) const {
        return (lit[step * packets + point / points_at_once] >> (point % points_at_once) & 1) != 0;
    }
};

/// Called some times a second.
/// @param share  how much is done, 0 to 1
/// @return false to end the work here
using SunWatch = std::function<bool(double share)>;

/// Finds for each point how long the sun reaches it: it counts where the side that is meant looks
/// toward it and no surface stands between, see GlassFilter. A sun below the horizon counts
/// nothing. The numbers do not depend on how many threads there are.
/// @param notes_steps  whether `lit` is wanted
/// @return false where `watch` ended the work
bool findSun(const DisplayScene& scene, const SurfacePoints& points, std::span<const SunStep> steps,
             bool notes_steps, const SunWatch& watch, SunLight& light);

} // namespace quarn
