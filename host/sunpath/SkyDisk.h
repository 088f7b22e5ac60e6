#pragma once

#include "host/sun/SunPosition.h"
#include "host/sunpath/Drawing.h"

namespace quarn {

/// How the sky is laid on a disk.
enum class SkyProjection {
    stereographic, ///< keeps angles; the radius is tan((90 degrees - altitude) / 2)
    orthographic,  ///< the sky seen from far above: the radius is cos(altitude)
};

/// The sky over a place as a disk: the zenith in its middle, the horizon its rim, north up and east
/// to the right as on a plan.
struct SkyDisk {
    SkyProjection projection;
    DrawnPoint middle;
    double radius_px; ///< of the horizon

    /// How far from the middle an altitude lies, of 0 to 90 degrees.
    double radiusOf(double altitude_deg) const;
    /// @param direction  above the horizon
    DrawnPoint at(const SunPosition& direction) const;
    /// A place on the rim, or outside of it.
    DrawnPoint onRim(double azimuth_deg, double beyond_px = 0) const;
};

} // namespace quarn
