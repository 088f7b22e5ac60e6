#include "kelmar/KM_Circle.h"

#include "kelmar/KM_NurbsCurve.h"

#include <array>
#include <cmath>

namespace {

constexpr int corner_count = 9;

// Corners of the square about the circle and the middles of its sides, as multiples of the radius
// along the plane's axes. The corners have the weight cos 45 degrees.
constexpr std::array<std::array<int, 2>, corner_count> square = {
    {{1, 0}, {1, 1}, {0, 1}, {-1, 1}, {-1, 0}, {-1, -1}, {0, -1}, {1, -1}, {1, 0}}};

constexpr double corner_weight = 0.70710678118654752440;

} // namespace

KM_Circle::KM_Circle(const KM_Plane& plane_, double radius_) : plane(plane_), radius(radius_) {}

bool KM_Circle::IsValid() const {
    return plane.IsValid() && KM_IsValid(radius) && radius > 0.0;
}

KM_3dPoint KM_Circle::PointAt(double angle) const {
    return plane.PointAt(radius * std::cos(angle), radius * std::sin(angle));
}

int KM_Circle::GetNurbForm(KM_NurbsCurve& curve) const {
    KM_NurbsCurve circle;
    if (!IsValid() || !circle.Create(3, true, 3, corner_count))
        return 0;
    for (int i = 0; i < corner_count; ++i) {
        const auto& place = square[static_cast<std::size_t>(i)];
        circle.SetCV(i, plane.PointAt(radius * place[0], radius * place[1]));
        circle.SetWeight(i, i % 2 == 0 ? 1.0 : corner_weight);
    }
    // Each quarter turn is a piece of its own between double knots.
    for (int i = 0; i < circle.KnotCount(); ++i)
        circle.SetKnot(i, (i / 2) * (0.5 * KM_PI));
    curve = circle;
    return 2;
}
