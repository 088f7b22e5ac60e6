#pragma once

#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Mesh.h"

#include <cstdint>
#include <memory>
#include <vector>

namespace quarn {

class MeshEdges;

/// A document's mesh made ready for the ray loops, which read the mesh's own vertices and
/// triangles; only the normals are repeated, packed and by triangle corner, because they are read
/// at random for every pixel.
class RayMesh {
public:
    /// The mesh must not change while this lives.
    explicit RayMesh(std::shared_ptr<const KM_Mesh> mesh);
    ~RayMesh();
    RayMesh(const RayMesh&) = delete;
    RayMesh& operator=(const RayMesh&) = delete;

    /// False when an index names no vertex, the optional arrays do not fit or a vertex is out of
    /// range: such a mesh is not drawn.
    bool isDrawable() const { return m_drawable; }
    /// False when there is a mesh and one of its vertices is out of range.
    bool isInRange() const { return m_in_range; }
    const KM_Mesh& mesh() const { return *m_mesh; }
    const KM_BoundingBox& box() const { return m_box; }
    /// Three a triangle, or null when the mesh has no normals.
    const std::uint32_t* cornerNormals() const;
    /// The vertices, followed by at least 4 bytes that may be read.
    const KM_3fPoint* paddedVertices() const;
    /// The lines of the mesh, found at the first call.
    const MeshEdges& edges() const;

private:
    void packNormals();
    void padVertices();

    std::shared_ptr<const KM_Mesh> m_mesh;
    KM_BoundingBox m_box;
    bool m_drawable = false;
    bool m_in_range = true;
    std::unique_ptr<std::uint32_t[]> m_corner_normals; ///< null when the mesh has no normals
    std::vector<KM_3fPoint> m_padded_copy; ///< empty when the mesh's own vertices are padded
    mutable std::unique_ptr<MeshEdges> m_edges;
};

} // namespace quarn
