#pragma once

#include "kelmar/KM_Mesh.h"

#include <cmath>

/// Normals of single triangles, in the single precision of meshes.
namespace quarn::face_normals {

using Vector = KM_3fVector;

inline Vector operator-(const KM_3fPoint& a, const KM_3fPoint& b) {
    return {a.x - b.x, a.y - b.y, a.z - b.z};
}

inline Vector& operator+=(Vector& a, const Vector& b) {
    a = {a.x + b.x, a.y + b.y, a.z + b.z};
    return a;
}

inline float dot(const Vector& a, const Vector& b) {
    return a.x * b.x + a.y * b.y + a.z * b.z;
}

inline Vector scaled(const Vector& v, float factor) {
    return {v.x * factor, v.y * factor, v.z * factor};
}

/// Zero for a vector too short to have a direction, and for one that overflowed.
inline Vector unit(const Vector& v) {
    const float square = dot(v, v);
    return square > 0.0F && std::isfinite(square) ? scaled(v, 1.0F / std::sqrt(square)) : Vector{};
}

inline bool isZero(const Vector& v) {
    return v.x == 0.0F && v.y == 0.0F && v.z == 0.0F;
}

inline Vector cross(const Vector& a, const Vector& b) {
    return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
}

/// True where products of four lengths, whose square this is, stay well inside the range of a
/// float.
inline bool isModest(float square) {
    return square > 1e-9F && square < 1e9F;
}

/// The edges of tiny and huge triangles are made unit vectors first.
inline Vector faceNormal(const KM_Mesh& mesh, const KM_MeshTriangle& face) {
    const KM_3fPoint& origin = mesh.m_V[face.vi[0]];
    const Vector a = mesh.m_V[face.vi[1]] - origin;
    const Vector b = mesh.m_V[face.vi[2]] - origin;
    const bool modest = isModest(dot(a, a)) && isModest(dot(b, b));
    return unit(modest ? cross(a, b) : cross(unit(a), unit(b)));
}

/// The normal of a triangle at one of its corners, as long as its weight.
inline Vector weightedNormal(const KM_Mesh& mesh, const KM_MeshTriangle& face, int corner) {
    const KM_3fPoint& here = mesh.m_V[face.vi[corner]];
    const Vector a = mesh.m_V[face.vi[(corner + 1) % 3]] - here;
    const Vector b = mesh.m_V[face.vi[(corner + 2) % 3]] - here;
    const float aa = dot(a, a);
    const float bb = dot(b, b);
    if (isModest(aa) && isModest(bb)) {
        return scaled(cross(a, b), 1.0F / (aa * bb));
    }
    const float weight = std::sqrt(aa * bb);
    const Vector turned = cross(unit(a), unit(b));
    return weight > 0.0F && std::isfinite(1.0F / weight) ? scaled(turned, 1.0F / weight) : turned;
}

} // namespace quarn::face_normals
