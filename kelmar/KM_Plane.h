#pragma once

#include "kelmar/KM_Export.h"
#include "kelmar/KM_Point.h"

class KM_Xform;

/// A plane with a right-handed frame of unit axes: x and y lie in it, z is its normal.
class KELMAR_API KM_Plane {
public:
    KM_3dPoint origin;
    KM_3dVector xaxis{1.0, 0.0, 0.0};
    KM_3dVector yaxis{0.0, 1.0, 0.0};
    KM_3dVector zaxis{0.0, 0.0, 1.0};

    /// The world XY plane.
    constexpr KM_Plane() = default;
    /// The plane through `origin` with the direction `normal` of any length. Its x axis is the one
    /// that KM_3dVector::PerpendicularTo gives; with the normal +Z the axes are the world's. A zero
    /// or invalid normal gives a plane that is not valid.
    KM_Plane(const KM_3dPoint& origin, const KM_3dVector& normal);
    /// The plane through `origin` whose x axis has the direction `x` and whose y axis lies on the
    /// side of `y`. Parallel, zero or invalid directions give a plane that is not valid.
    KM_Plane(const KM_3dPoint& origin, const KM_3dVector& x, const KM_3dVector& y);

    /// True when the origin is valid and the axes are unit vectors of a right-handed frame.
    bool IsValid() const;
    const KM_3dPoint& Origin() const { return origin; }
    /// Moves the plane so that its origin is `point`; the axes stay.
    void SetOrigin(const KM_3dPoint& point) { origin = point; }
    const KM_3dVector& Normal() const { return zaxis; }

    /// Moves the origin by the vector.
    /// @return false, with the plane unchanged, when the vector is invalid
    bool Translate(const KM_3dVector& delta);
    /// Moves the origin and the axes by the matrix and makes the frame right-handed and of unit
    /// length again.
    /// @return false, with the plane unchanged, when the matrix flattens the plane or is invalid
    bool Transform(const KM_Xform& xform);

    /// origin + u * xaxis + v * yaxis
    KM_3dPoint PointAt(double u, double v) const;
    /// Distance of the point in model units, positive on the side of the normal.
    double DistanceTo(const KM_3dPoint& point) const;
};

/// The world XY plane: origin (0, 0, 0), normal +Z.
extern KELMAR_API const KM_Plane KM_xy_plane;
