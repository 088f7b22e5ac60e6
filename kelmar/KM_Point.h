#pragma once

#include "kelmar/KM_Export.h"

#include <cmath>

class KM_Xform;

/// Marks a number that has no value. A number so far out occurs in no model.
inline constexpr double KM_UNSET_VALUE = -1.23432101234321e+308;

/// 2^-32. A vector none of whose coordinates exceeds it counts as tiny.
inline constexpr double KM_ZERO_TOLERANCE = 2.3283064365386963e-10;

inline constexpr double KM_PI = 3.14159265358979323846;

/// True when the number is finite and is not KM_UNSET_VALUE.
inline bool KM_IsValid(double number) {
    return std::isfinite(number) && number != KM_UNSET_VALUE;
}

class KM_3dPoint;

/// A point of the plane or a pair of parameters.
class KELMAR_API KM_2dPoint {
public:
    double x = 0.0;
    double y = 0.0;

    constexpr KM_2dPoint() = default;
    constexpr KM_2dPoint(double x_, double y_) : x(x_), y(y_) {}

    bool IsValid() const { return KM_IsValid(x) && KM_IsValid(y); }
    friend bool operator==(const KM_2dPoint&, const KM_2dPoint&) = default;
};

/// A direction with a length, in model units. It has no place: translations do not move it.
class KELMAR_API KM_3dVector {
public:
    double x = 0.0;
    double y = 0.0;
    double z = 0.0;

    static const KM_3dVector ZeroVector;
    static const KM_3dVector XAxis;
    static const KM_3dVector YAxis;
    static const KM_3dVector ZAxis;
    /// All coordinates are KM_UNSET_VALUE.
    static const KM_3dVector UnsetVector;

    /// The zero vector.
    constexpr KM_3dVector() = default;
    constexpr KM_3dVector(double x_, double y_, double z_) : x(x_), y(y_), z(z_) {}
    /// The vector from the world origin to the point.
    explicit constexpr KM_3dVector(const KM_3dPoint& point);

    /// True when every coordinate is finite and set.
    bool IsValid() const { return KM_IsValid(x) && KM_IsValid(y) && KM_IsValid(z); }
    /// True when every coordinate's absolute value is at most `tolerance`.
    bool IsTiny(double tolerance = KM_ZERO_TOLERANCE) const;
    /// True when every coordinate is 0.
    bool IsZero() const { return x == 0.0 && y == 0.0 && z == 0.0; }
    /// True when the length is 1 within 2^-32.
    bool IsUnitVector() const;

    /// Euclidean length; neither overflows nor underflows on the way. 0 for an invalid vector.
    double Length() const;
    double LengthSquared() const { return x * x + y * y + z * z; }

    /// Scales the vector to length 1.
    /// @return false, with the vector unchanged, when it is zero or invalid
    bool Unitize();
    void Reverse();
    /// Multiplies by the matrix; its translation is ignored.
    void Transform(const KM_Xform& xform);

    /// Sets this to a unit vector perpendicular to `other`, always the same one for the same
    /// direction.
    /// @return false, with this vector set to zero, when `other` is zero or invalid
    bool PerpendicularTo(const KM_3dVector& other);
    /// Compares directions.
    /// @param angle_tolerance  radians
    /// @return 1 same direction, -1 opposite direction, 0 neither, or either vector zero or
    ///         invalid
    int IsParallelTo(const KM_3dVector& other, double angle_tolerance = KM_PI / 180.0) const;

    KM_3dVector& operator+=(const KM_3dVector& v);
    KM_3dVector& operator-=(const KM_3dVector& v);
    KM_3dVector& operator*=(double scale);
    /// Division by 0 gives infinite or not-a-number coordinates, which IsValid reports.
    KM_3dVector& operator/=(double divisor);

    friend bool operator==(const KM_3dVector&, const KM_3dVector&) = default;
    friend constexpr KM_3dVector operator-(const KM_3dVector& v) { return {-v.x, -v.y, -v.z}; }
    friend constexpr KM_3dVector operator+(const KM_3dVector& a, const KM_3dVector& b) {
        return {a.x + b.x, a.y + b.y, a.z + b.z};
    }
    friend constexpr KM_3dVector operator-(const KM_3dVector& a, const KM_3dVector& b) {
        return {a.x - b.x, a.y - b.y, a.z - b.z};
    }
    friend constexpr KM_3dVector operator*(const KM_3dVector& v, double s) {
        return {v.x * s, v.y * s, v.z * s};
    }
    friend constexpr KM_3dVector operator*(double s, const KM_3dVector& v) { return v * s; }
    friend constexpr KM_3dVector operator/(const KM_3dVector& v, double s) {
        return {v.x / s, v.y / s, v.z / s};
    }
    /// Dot product.
    friend constexpr double operator*(const KM_3dVector& a, const KM_3dVector& b) {
        return a.x * b.x + a.y * b.y + a.z * b.z;
    }
};

constexpr double KM_DotProduct(const KM_3dVector& a, const KM_3dVector& b) {
    return a * b;
}

/// The vector perpendicular to both, right-handed: X cross Y is Z.
constexpr KM_3dVector KM_CrossProduct(const KM_3dVector& a, const KM_3dVector& b) {
    return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
}

/// A place in the model, in model units: x east, y north, z up in a model that was not turned.
class KELMAR_API KM_3dPoint {
public:
    double x = 0.0;
    double y = 0.0;
    double z = 0.0;

    /// (0, 0, 0)
    static const KM_3dPoint Origin;
    /// All coordinates are KM_UNSET_VALUE: "no point".
    static const KM_3dPoint UnsetPoint;

    /// The world origin.
    constexpr KM_3dPoint() = default;
    constexpr KM_3dPoint(double x_, double y_, double z_) : x(x_), y(y_), z(z_) {}
    /// The point that the vector leads to from the world origin.
    explicit constexpr KM_3dPoint(const KM_3dVector& v) : x(v.x), y(v.y), z(v.z) {}

    /// True when every coordinate is finite and set.
    bool IsValid() const { return KM_IsValid(x) && KM_IsValid(y) && KM_IsValid(z); }
    /// Euclidean distance; neither overflows nor underflows on the way.
    double DistanceTo(const KM_3dPoint& other) const;
    /// Moves this point by the matrix, with the perspective division where the matrix has one.
    void Transform(const KM_Xform& xform);

    KM_3dPoint& operator+=(const KM_3dVector& v);
    KM_3dPoint& operator-=(const KM_3dVector& v);

    friend bool operator==(const KM_3dPoint&, const KM_3dPoint&) = default;
    friend constexpr KM_3dPoint operator+(const KM_3dPoint& p, const KM_3dVector& v) {
        return {p.x + v.x, p.y + v.y, p.z + v.z};
    }
    friend constexpr KM_3dPoint operator-(const KM_3dPoint& p, const KM_3dVector& v) {
        return {p.x - v.x, p.y - v.y, p.z - v.z};
    }
    friend constexpr KM_3dVector operator-(const KM_3dPoint& a, const KM_3dPoint& b) {
        return {a.x - b.x, a.y - b.y, a.z - b.z};
    }
    /// Scale the coordinates about the world origin.
    friend constexpr KM_3dPoint operator*(const KM_3dPoint& p, double s) {
        return {p.x * s, p.y * s, p.z * s};
    }
    friend constexpr KM_3dPoint operator*(double s, const KM_3dPoint& p) { return p * s; }
    friend constexpr KM_3dPoint operator/(const KM_3dPoint& p, double s) {
        return {p.x / s, p.y / s, p.z / s};
    }
};

constexpr KM_3dVector::KM_3dVector(const KM_3dPoint& point) : x(point.x), y(point.y), z(point.z) {}

/// A point as meshes store it.
class KELMAR_API KM_3fPoint {
public:
    float x = 0.0F;
    float y = 0.0F;
    float z = 0.0F;

    constexpr KM_3fPoint() = default;
    constexpr KM_3fPoint(float x_, float y_, float z_) : x(x_), y(y_), z(z_) {}
    /// Rounds to the nearest floats; a coordinate beyond their range becomes infinite.
    explicit KM_3fPoint(const KM_3dPoint& p);

    bool IsValid() const { return std::isfinite(x) && std::isfinite(y) && std::isfinite(z); }
    KM_3dPoint ToDouble() const { return {x, y, z}; }
    friend bool operator==(const KM_3fPoint&, const KM_3fPoint&) = default;
};

/// A vector as meshes store it.
class KELMAR_API KM_3fVector {
public:
    float x = 0.0F;
    float y = 0.0F;
    float z = 0.0F;

    constexpr KM_3fVector() = default;
    constexpr KM_3fVector(float x_, float y_, float z_) : x(x_), y(y_), z(z_) {}
    /// Rounds to the nearest floats; a coordinate beyond their range becomes infinite.
    explicit KM_3fVector(const KM_3dVector& v);

    bool IsValid() const { return std::isfinite(x) && std::isfinite(y) && std::isfinite(z); }
    KM_3dVector ToDouble() const { return {x, y, z}; }
    friend bool operator==(const KM_3fVector&, const KM_3fVector&) = default;
};

/// A texture coordinate as meshes store it: (0, 0) is the lower left corner of the picture.
class KELMAR_API KM_2fPoint {
public:
    float x = 0.0F;
    float y = 0.0F;

    constexpr KM_2fPoint() = default;
    constexpr KM_2fPoint(float x_, float y_) : x(x_), y(y_) {}

    bool IsValid() const { return std::isfinite(x) && std::isfinite(y); }
    friend bool operator==(const KM_2fPoint&, const KM_2fPoint&) = default;
};
