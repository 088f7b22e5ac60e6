#include "kelmar/KM_Point.h"

#include "kelmar/KM_Xform.h"

#include <algorithm>

constinit const KM_3dVector KM_3dVector::ZeroVector{0.0, 0.0, 0.0};
constinit const KM_3dVector KM_3dVector::XAxis{1.0, 0.0, 0.0};
constinit const KM_3dVector KM_3dVector::YAxis{0.0, 1.0, 0.0};
constinit const KM_3dVector KM_3dVector::ZAxis{0.0, 0.0, 1.0};
constinit const KM_3dVector KM_3dVector::UnsetVector{KM_UNSET_VALUE, KM_UNSET_VALUE,
                                                     KM_UNSET_VALUE};
constinit const KM_3dPoint KM_3dPoint::Origin{0.0, 0.0, 0.0};
constinit const KM_3dPoint KM_3dPoint::UnsetPoint{KM_UNSET_VALUE, KM_UNSET_VALUE, KM_UNSET_VALUE};

namespace {

double largestCoordinate(const KM_3dVector& v) {
    return std::max({std::abs(v.x), std::abs(v.y), std::abs(v.z)});
}

// Squares of coordinates in this range neither overflow nor lose digits by underflow.
bool squaresAreSafe(double largest) {
    return largest > 1e-140 && largest < 1e150;
}

// A valid vector other than zero, scaled by a power of two so that its largest coordinate lies in
// [1, 2).
KM_3dVector scaledToOne(const KM_3dVector& v) {
    const int exponent = std::ilogb(largestCoordinate(v));
    const auto scale = [exponent](double c) { return std::ldexp(c, -exponent); };
    return {scale(v.x), scale(v.y), scale(v.z)};
}

} // namespace

bool KM_3dVector::IsTiny(double tolerance) const {
    return std::abs(x) <= tolerance && std::abs(y) <= tolerance && std::abs(z) <= tolerance;
}

bool KM_3dVector::IsUnitVector() const {
    return IsValid() && std::abs(Length() - 1.0) <= KM_ZERO_TOLERANCE;
}

double KM_3dVector::Length() const {
    if (!IsValid() || IsZero())
        return 0.0;
    const double largest = largestCoordinate(*this);
    if (squaresAreSafe(largest))
        return std::sqrt(LengthSquared());
    return std::ldexp(std::sqrt(scaledToOne(*this).LengthSquared()), std::ilogb(largest));
}

bool KM_3dVector::Unitize() {
    if (!IsValid() || IsZero())
        return false;
    const KM_3dVector v = squaresAreSafe(largestCoordinate(*this)) ? *this : scaledToOne(*this);
    *this = v / std::sqrt(v.LengthSquared());
    return true;
}

void KM_3dVector::Reverse() {
    *this = -*this;
}

void KM_3dVector::Transform(const KM_Xform& xform) {
    *this = xform * *this;
}

bool KM_3dVector::PerpendicularTo(const KM_3dVector& other) {
    *this = ZeroVector;
    KM_3dVector n = other;
    if (!n.Unitize())
        return false;
    // Horizontal where it can be; near the vertical the world's Y serves, so that +Z gives +X.
    const bool nearly_vertical = std::abs(n.x) < 1.0 / 64.0 && std::abs(n.y) < 1.0 / 64.0;
    *this = KM_CrossProduct(nearly_vertical ? YAxis : ZAxis, n);
    return Unitize();
}

int KM_3dVector::IsParallelTo(const KM_3dVector& other, double angle_tolerance) const {
    KM_3dVector a = *this;
    KM_3dVector b = other;
    if (!a.Unitize() || !b.Unitize())
        return 0;
    const double sine = KM_CrossProduct(a, b).Length();
    const double cosine = a * b;
    if (std::atan2(sine, cosine) <= angle_tolerance)
        return 1;
    return std::atan2(sine, -cosine) <= angle_tolerance ? -1 : 0;
}

KM_3dVector& KM_3dVector::operator+=(const KM_3dVector& v) {
    return *this = *this + v;
}

KM_3dVector& KM_3dVector::operator-=(const KM_3dVector& v) {
    return *this = *this - v;
}

KM_3dVector& KM_3dVector::operator*=(double scale) {
    return *this = *this * scale;
}

KM_3dVector& KM_3dVector::operator/=(double divisor) {
    return *this = *this / divisor;
}

double KM_3dPoint::DistanceTo(const KM_3dPoint& other) const {
    return (other - *this).Length();
}

void KM_3dPoint::Transform(const KM_Xform& xform) {
    *this = xform * *this;
}

KM_3dPoint& KM_3dPoint::operator+=(const KM_3dVector& v) {
    return *this = *this + v;
}

KM_3dPoint& KM_3dPoint::operator-=(const KM_3dVector& v) {
    return *this = *this - v;
}

KM_3fPoint::KM_3fPoint(const KM_3dPoint& p)
    : x(static_cast<float>(p.x)), y(static_cast<float>(p.y)), z(static_cast<float>(p.z)) {}

KM_3fVector::KM_3fVector(const KM_3dVector& v)
    : x(static_cast<float>(v.x)), y(static_cast<float>(v.y)), z(static_cast<float>(v.z)) {}
