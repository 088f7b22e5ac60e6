#pragma once

#include "kelmar/KM_3dPointArray.h"

class KM_Curve;

namespace quarn {

/// A curve as straight pieces. Of one that is out of range only the corners of its box, which say
/// where it lies: to divide it could take long.
/// @param tolerance_of_size  how far the pieces may lie beside the curve, as a share of its size
KM_3dPointArray displayPolyline(const KM_Curve& curve, double tolerance_of_size);

} // namespace quarn
