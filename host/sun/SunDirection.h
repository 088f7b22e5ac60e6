#pragma once

#include "host/sun/SunPosition.h"
#include "kelmar/KM_Point.h"

namespace quarn {

/// The direction toward a sun, where north is the world Y axis.
/// @return a unit vector (x east, y north, z up)
KM_3dVector directionToSun(const SunPosition& position);

/// Where the sun stands in a direction, where north is the world Y axis.
/// @param direction  a unit vector
/// @return the azimuth from 0 up to but not including 360; 0 for a sun straight above or below
SunPosition positionOfSun(const KM_3dVector& direction);

} // namespace quarn
