#pragma once

#include "kelmar/KM_BinaryArchive.h"
#include "kelmar/KM_Curve.h"

#include <memory>

namespace quarn {

/// Writes a line, a polyline or a NURBS curve.
/// @return false, with the archive failed, also for a curve of another type and for one that
///         readCurve would refuse
bool writeCurve(KM_BinaryArchive& archive, const KM_Curve& curve);

/// Reads a curve to the last bit.
/// @return null, with the archive failed, when there is none that could be written
std::unique_ptr<KM_Curve> readCurve(KM_BinaryArchive& archive);

} // namespace quarn
