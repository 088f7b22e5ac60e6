#pragma once

#include "kelmar/KM_Export.h"
#include "kelmar/KM_Plane.h"

class KM_NurbsCurve;

/// A circle about the origin of a plane. Angles are radians from the plane's x axis toward its y
/// axis, which is anticlockwise seen from the tip of the normal.
class KELMAR_API KM_Circle {
public:
    KM_Plane plane;
    /// In model units.
    double radius = 1.0;

    /// The unit circle of the world XY plane.
    constexpr KM_Circle() = default;
    KM_Circle(const KM_Plane& plane, double radius);

    /// True when the plane is valid and the radius is finite and above 0.
    bool IsValid() const;
    /// plane.origin + radius * (cos(angle) * xaxis + sin(angle) * yaxis)
    KM_3dPoint PointAt(double angle) const;
    /// In model units.
    double Circumference() const { return 2.0 * KM_PI * radius; }

    /// Writes the whole circle as a rational curve of degree 2 with 9 control points and the domain
    /// [0, 2 pi]; Piegl and Tiller, The NURBS Book, section 7.5, example 7.3. The curve starts at
    /// PointAt(0) and runs anticlockwise seen from the tip of the normal. Every point is at the
    /// radius, and at whole quarters of the domain parameter and angle agree; in between they
    /// differ by less than 0.0161 radians.
    /// @return 2 on success; 0, with `curve` unchanged, when the circle is not valid
    int GetNurbForm(KM_NurbsCurve& curve) const;
};
