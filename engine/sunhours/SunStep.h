#pragma once

#include "kelmar/KM_Point.h"

namespace quarn {

/// A moment of the sun's way, and how long it stands for.
struct SunStep {
    KM_3dVector toward; ///< unit vector in world coordinates; below the horizon where z <= 0
    double hours = 0.0;
};

} // namespace quarn
