#include "host/curves/CurveMaking.h"

#include "kelmar/KM_Circle.h"
#include "kelmar/KM_LineCurve.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

namespace quarn {

namespace {

Error tooFew(const std::string& what, std::size_t least, std::size_t given) {
    return Error{what + " takes " + std::to_string(least) + " points or more; " +
                 std::to_string(given) + (given == 1 ? " was given." : " were given.")};
}

Error coinciding() {
    return Error{"Two points that follow each other are at the same place. Leave one out."};
}

bool neighboursCoincide(std::span<const KM_3dPoint> points) {
    return std::ranges::adjacent_find(points) != points.end();
}

/// Hands a curve on when it can be followed.
CurveResult checked(std::unique_ptr<KM_Curve> curve) {
    double length = 0.0;
    const bool is_huge = !curve->BoundingBox().Diagonal().IsValid();
    if (!curve->IsValid() && !is_huge)
        return Error{"All points are at the same place."};
    if (is_huge || !curve->GetLength(&length) || !KM_IsValid(length))
        return Error{"The points are too far apart."};
    if (!(length > 0.0))
        return Error{"The points are too near to each other."};
    return CurveResult(std::move(curve));
}

/// The points of a closed curve, without the first one at the end.
std::span<const KM_3dPoint> withoutRepeat(std::span<const KM_3dPoint> points) {
    const bool repeats = points.size() > 1 && points.front() == points.back();
    return repeats ? points.first(points.size() - 1) : points;
}

Error badDegree() {
    return Error{"The degree of a curve is from 1 to " + std::to_string(HIGHEST_DEGREE) + "."};
}

/// Beyond it most of the curve lies in so small a part of its domain that its length comes out
/// wrong.
constexpr double LARGEST_WEIGHT_RATIO = 1e6;

bool areFarApart(std::span<const double> weights) {
    if (weights.empty())
        return false;
    const auto [least, most] = std::ranges::minmax(weights);
    return most > LARGEST_WEIGHT_RATIO * least;
}

bool setWeights(KM_NurbsCurve& curve, std::span<const double> weights) {
    // Behind the last point of a periodic curve its first ones come again.
    for (int i = 0; i < curve.CVCount() && !weights.empty(); ++i)
        if (!curve.SetWeight(i, weights[static_cast<std::size_t>(i) % weights.size()]))
            return false;
    return true;
}

} // namespace

CurveResult makeLine(const KM_3dPoint& start, const KM_3dPoint& end) {
    if (start == end)
        return Error{"The line ends where it starts."};
    return checked(std::make_unique<KM_LineCurve>(start, end));
}

CurveResult makePolyline(std::span<const KM_3dPoint> corners, bool closed) {
    const auto distinct = closed ? withoutRepeat(corners) : corners;
    const std::size_t least = closed ? 3 : 2;
    if (distinct.size() < least)
        return tooFew(closed ? "A closed polyline" : "A polyline", least, distinct.size());
    std::vector<KM_3dPoint> points(distinct.begin(), distinct.end());
    if (closed)
        points.push_back(points.front());
    if (neighboursCoincide(points))
        return coinciding();
    return checked(std::make_unique<KM_PolylineCurve>(points));
}

CurveResult makeSpline(std::span<const KM_3dPoint> control_points, int degree, bool closed,
                       std::span<const double> weights) {
    if (degree < 1 || degree > HIGHEST_DEGREE)
        return badDegree();
    if (!weights.empty() && weights.size() != control_points.size())
        return Error{"A curve has as many weights as points."};
    const auto points = closed ? withoutRepeat(control_points) : control_points;
    const std::string what =
        (closed ? "A closed curve of degree " : "A curve of degree ") + std::to_string(degree);
    const std::size_t least = static_cast<std::size_t>(closed ? std::max(3, degree) : degree + 1);
    if (points.size() < least)
        return tooFew(what, least, points.size());
    auto curve = std::make_unique<KM_NurbsCurve>();
    const bool made = closed ? curve->CreatePeriodicUniformNurbs(points, degree + 1)
                             : curve->CreateClampedUniformNurbs(points, degree + 1);
    if (!made)
        return Error{what + " cannot be made of these points."};
    if (areFarApart(weights))
        return Error{"The weights of points differ by a factor of more than 1,000,000. Bring them "
                     "nearer to each other."};
    if (!setWeights(*curve, weights.first(std::min(weights.size(), points.size()))))
        return Error{"The weight of a point is a number above 0."};
    return checked(std::move(curve));
}

CurveResult makeSplineThrough(std::span<const KM_3dPoint> points, bool closed) {
    const auto passed = closed ? withoutRepeat(points) : points;
    const std::size_t least = closed ? 3 : 2;
    if (passed.size() < least)
        return tooFew(closed ? "A closed curve through points" : "A curve through points", least,
                      passed.size());
    if (neighboursCoincide(passed))
        return coinciding();
    auto curve = std::make_unique<KM_NurbsCurve>();
    if (!curve->CreateCubicThroughPoints(passed, closed))
        return Error{"The points are too far apart, or too near to each other, for a curve."};
    return checked(std::move(curve));
}

CurveResult makeCircle(const KM_3dPoint& centre, const KM_3dVector& normal, double radius) {
    if (!KM_IsValid(radius) || !(radius > 0.0))
        return Error{"The radius of a circle is above 0."};
    const KM_Circle circle(KM_Plane(centre, normal), radius);
    auto curve = std::make_unique<KM_NurbsCurve>();
    if (circle.GetNurbForm(*curve) == 0)
        return Error{"The axis of a circle needs a direction, such as 0,0,1."};
    if (std::abs(curve->PointAtStart().DistanceTo(centre) - radius) > 1e-6 * radius)
        return Error{"The circle is too small to be drawn so far from the origin."};
    return checked(std::move(curve));
}

} // namespace quarn
