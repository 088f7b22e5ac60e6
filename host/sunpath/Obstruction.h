#pragma once

#include "host/sunpath/SkyDisk.h"
#include "kelmar/KM_Point.h"

#include <cstddef>
#include <optional>
#include <vector>

namespace quarn {

class DisplayScene;

/// What hides the sky from a point: looked at along lines from the horizon to the zenith, at even
/// steps of the azimuth, the first half a step from north: walls that stand along the axes or
/// halfway between them are not looked along.
struct Obstruction {
    /// A part of such a line that is hidden, by altitudes of 0 to 90 degrees.
    struct Band {
        double low_deg;
        double high_deg;
    };
    std::vector<std::vector<Band>> lines; ///< each from the horizon up; empty: nobody looked

    double azimuthOf(std::size_t line) const {
        return 360.0 * (static_cast<double>(line) + 0.5) / static_cast<double>(lines.size());
    }
};

/// Where somebody stands who looks at the sky.
struct SkyWatch {
    KM_3dPoint point;     ///< in the world; a surface that it lies on should be a little away
    double north_deg = 0; ///< clockwise from the world's Y axis, as seen from above
    std::optional<std::size_t> absent_mesh{}; ///< hides nothing; an index of DisplayScene::meshes
};

/// Looks around from a point with rays, to which glass is not there as GlassFilter has it, a
/// quarter of a degree of the azimuth and half a degree of the altitude apart; the borders of what
/// is hidden are found to a hundredth of a degree of the altitude. What is smaller than a step may
/// be missed. Takes some tenths of a second.
Obstruction obstructionAround(const DisplayScene& scene, const SkyWatch& watch);

/// What is hidden as areas of a disk, to be filled as one path.
std::vector<std::vector<DrawnPoint>> hiddenAreas(const Obstruction& obstruction,
                                                 const SkyDisk& disk);

} // namespace quarn
