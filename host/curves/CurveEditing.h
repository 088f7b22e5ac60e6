#pragma once

#include "host/curves/CurveMaking.h"

namespace quarn {

/// How many points of a curve can be moved: the ends of a line, the corners of a polyline, the
/// control points of a NURBS curve. Of a closed curve those that stand at its start and again at
/// its end count once. 0 for other kinds of curves.
int movablePointCount(const KM_Curve& curve);

/// A copy of the curve with one point elsewhere. A closed curve stays closed; weights, knots and
/// parameters stay.
/// @param index  from 0
/// @return an error for an index outside 0 to movablePointCount() - 1, an invalid place, a corner
///         that comes to lie on its neighbour, and a curve that would have no extent
CurveResult withMovedPoint(const KM_Curve& curve, int index, const KM_3dPoint& place);

} // namespace quarn
