#pragma once

#include "ground/Result.h"
#include "kelmar/KM_Curve.h"

#include <memory>
#include <span>

namespace quarn {

using CurveResult = Result<std::unique_ptr<KM_Curve>>;

/// The highest degree that a person can ask for. Curves up to it are evaluated without asking for
/// memory.
constexpr int HIGHEST_DEGREE = 15;

/// A straight curve with the domain [0, 1].
/// @return an error when the ends coincide
CurveResult makeLine(const KM_3dPoint& start, const KM_3dPoint& end);

/// Straight segments; corner i has the parameter i. A closed one ends at its first corner, which
/// may be repeated at the end but need not be.
/// @return an error for less than 2 corners (3 when closed), and when neighbours coincide
CurveResult makePolyline(std::span<const KM_3dPoint> corners, bool closed);

/// A curve drawn toward control points: clamped with uniform knots, or closed and smooth all over.
/// @param weights  of the control points, all above 0; none for a curve that is not rational
/// @return an error for a degree outside 1 to HIGHEST_DEGREE, for less than degree + 1 points
///         (closed: less than the degree or 3), when all points coincide, and for weights that are
///         not above 0 or differ by a factor of more than a million
CurveResult makeSpline(std::span<const KM_3dPoint> control_points, int degree, bool closed,
                       std::span<const double> weights = {});

/// The cubic curve through points, with the lengths of their chords as parameters.
/// @return an error for less than 2 points (3 when closed), and when neighbours coincide
CurveResult makeSplineThrough(std::span<const KM_3dPoint> points, bool closed);

/// An exact circle, anticlockwise seen from the tip of the normal.
/// @param normal  the direction of its axis, of any length
/// @return an error for a radius that is not above 0 and for a normal without a direction
CurveResult makeCircle(const KM_3dPoint& centre, const KM_3dVector& normal, double radius);

} // namespace quarn
