#pragma once

#include "engine/display/DisplayScene.h"
#include "engine/display/RayMesh.h"
#include "engine/sunhours/SurfacePoints.h"
#include "kelmar/KM_Mesh.h"

namespace quarn {

/// A triangle of a mesh object in the coordinates of the scene's rays.
class SceneTriangle {
public:
    SceneTriangle(const DisplayScene::MeshObject& object, const KM_MeshTriangle& indices);

    double area() const { return 0.5 * m_normal.Length(); }
    double longestEdge() const;
    /// corner 0 + u * (corner 1 - corner 0) + v * (corner 2 - corner 0)
    KM_3dPoint at(double u, double v) const;
    /// A point on its front, or on both sides; the triangle must have an area.
    SurfacePoint point(double u, double v, bool has_two_sides) const;

private:
    KM_3dPoint m_corner;
    KM_3dVector m_edges[2];
    KM_3dVector m_normal; ///< as long as two areas
};

} // namespace quarn
