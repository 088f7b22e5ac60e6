#pragma once

#include "kelmar/KM_Point.h"

/// Turns the north direction until it points at the sun.
///
/// @param azimuth_deg   degrees clockwise from the world Y axis, seen from above
/// @param altitude_deg  degrees above the horizon, negative at night
/// @return a unit vector from the model origin toward the sun; unset unless both are finite
KM_3dVector DirectionToSun(double azimuth_deg, double altitude_deg);
