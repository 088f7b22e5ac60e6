#include "engine/sunhours/SceneTriangles.h"

#include <algorithm>

namespace quarn {

SceneTriangle::SceneTriangle(const DisplayScene::MeshObject& object,
                             const KM_MeshTriangle& indices) {
    KM_3dPoint corners[3];
    for (int i = 0; i < 3; ++i) {
        const KM_3fPoint& own = object.mesh->mesh().m_V[indices.vi[i]];
        corners[i] = object.frame_from_mesh * KM_3dPoint(own.x, own.y, own.z);
    }
    m_corner = corners[0];
    m_edges[0] = corners[1] - corners[0];
    m_edges[1] = corners[2] - corners[0];
    m_normal = KM_CrossProduct(m_edges[0], m_edges[1]);
    if (object.frame_from_mesh.Determinant() < 0.0)
        m_normal = -m_normal; // a mirrored mesh keeps its front
}

double SceneTriangle::longestEdge() const {
    return std::max({m_edges[0].Length(), m_edges[1].Length(), (m_edges[1] - m_edges[0]).Length()});
}

KM_3dPoint SceneTriangle::at(double u, double v) const {
    return m_corner + u * m_edges[0] + v * m_edges[1];
}

SurfacePoint SceneTriangle::point(double u, double v, bool has_two_sides) const {
    const KM_3dPoint place = at(u, v);
    KM_3dVector face = m_normal;
    face.Unitize();
    return {{static_cast<float>(place.x), static_cast<float>(place.y), static_cast<float>(place.z)},
            {static_cast<float>(face.x), static_cast<float>(face.y), static_cast<float>(face.z)},
            has_two_sides};
}

} // namespace quarn
