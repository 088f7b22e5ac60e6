#pragma once

#include "host/curves/CurveMaking.h"
#include "kelmar/KM_Curve.h"

#include <memory>

namespace quarn {

/// A curve of the same shape that is run through at even speed: its parameter is its arc length in
/// model units, so that a camera that follows it neither rushes nor crawls. Equal steps of the
/// parameter give lengths that differ by less than 0.1 %.
///
/// Lines and polylines stay what they are, exactly; corners where a polyline stands still are left
/// out. Other curves become cubic ones of Bezier pieces with the curve's points and directions at
/// the ends of each; the curve's kinks stay, and a closed curve stays closed.
///
/// @param tolerance  how far the new curve may be from the old one, in model units, above 0; not
///                   less than what the rounding of its coordinates makes of it
/// @return an error when the curve is not valid, when it cannot be evaluated everywhere, and when
///         it would take more than a million pieces
CurveResult evenSpeedCurve(const KM_Curve& curve, double tolerance);

} // namespace quarn
