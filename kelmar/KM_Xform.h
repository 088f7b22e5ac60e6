#pragma once

#include "kelmar/KM_Export.h"
#include "kelmar/KM_Point.h"

class KM_Plane;

/// A 4 by 4 matrix that multiplies column vectors from the left: m_xform[row][column], translation
/// in column 3, perspective in row 3. `a * b` applies b first.
class KELMAR_API KM_Xform {
public:
    double m_xform[4][4] = {
        {1.0, 0.0, 0.0, 0.0}, {0.0, 1.0, 0.0, 0.0}, {0.0, 0.0, 1.0, 0.0}, {0.0, 0.0, 0.0, 1.0}};

    /// The identity.
    constexpr KM_Xform() = default;

    static KM_Xform Identity();
    static KM_Xform Translation(const KM_3dVector& delta);
    static KM_Xform Translation(double dx, double dy, double dz);
    /// Scales all three directions by `factor`; `center` stays.
    static KM_Xform Scale(const KM_3dPoint& center, double factor);
    /// Scales each axis by a factor of its own about the world origin.
    static KM_Xform Diagonal(double x, double y, double z);

    /// Turns about an axis by Rodrigues' formula (O. Rodrigues, 1840). Multiples of a quarter turn
    /// are exact.
    ///
    /// @param angle   radians, anticlockwise when the axis points at the observer
    /// @param axis    any length but 0
    /// @param center  a point of the axis; it stays where it is
    /// @return the identity when the axis is zero or anything is invalid
    static KM_Xform Rotation(double angle, const KM_3dVector& axis, const KM_3dPoint& center);

    /// As above, with the angle given by its sine and cosine. A pair that is not of length 1 is
    /// scaled to it, so |u x v| and u.v of two vectors of any length may be passed; the pair (0, 0)
    /// gives the identity.
    static KM_Xform Rotation(double sin_angle, double cos_angle, const KM_3dVector& axis,
                             const KM_3dPoint& center);

    /// The rotation through less than half a turn that carries one direction onto another.
    ///
    /// Equal directions give exactly the identity. Between opposite directions (within 2e-15) the
    /// turn is half a turn about world Z where both are perpendicular to it, else about some axis
    /// perpendicular to them.
    /// @return the identity when either direction is zero or invalid
    static KM_Xform Rotation(const KM_3dVector& start_direction, const KM_3dVector& end_direction,
                             const KM_3dPoint& center);

    /// Drops points onto the plane along its normal. For the world XY plane the result is exactly
    /// (x, y, 0).
    static KM_Xform PlanarProjection(const KM_Plane& plane);

    KM_Xform operator*(const KM_Xform& right) const;
    /// The moved point, divided by its fourth coordinate where that is not 1; the unset point where
    /// it is 0.
    KM_3dPoint operator*(const KM_3dPoint& point) const;
    /// The turned and scaled vector; translation and perspective are ignored.
    KM_3dVector operator*(const KM_3dVector& vector) const;
    friend bool operator==(const KM_Xform& a, const KM_Xform& b) = default;

    /// True when every entry is finite and set.
    bool IsValid() const;
    /// True when row 3 is (0, 0, 0, 1).
    bool IsAffine() const;
    /// True when no entry differs from the identity's by more than `tolerance`.
    bool IsIdentity(double tolerance = 0.0) const;
    double Determinant() const;
    /// Replaces the matrix by its inverse (Gauss-Jordan elimination with full pivoting).
    /// @return false, with the matrix unchanged, when it has none
    bool Invert();
    /// Swaps rows and columns.
    void Transpose();
};
