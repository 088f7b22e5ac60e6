#pragma once

#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Color.h"
#include "kelmar/KM_Export.h"
#include "kelmar/KM_Point.h"

#include <cstdint>
#include <vector>

class KM_wString;
class KM_Xform;

/// Three indices into a mesh's vertices, counted from 0, anticlockwise seen from outside.
struct KM_MeshTriangle {
    std::uint32_t vi[3] = {0, 0, 0};

    friend bool operator==(const KM_MeshTriangle&, const KM_MeshTriangle&) = default;
};

/// A triangle mesh in single precision. The arrays are laid out as the ray tracer reads them
/// (12 bytes a vertex, 12 bytes a triangle), so no second copy is needed.
class KELMAR_API KM_Mesh {
public:
    /// Vertices, in model units.
    std::vector<KM_3fPoint> m_V;
    /// Unit normals: none, or one per vertex.
    std::vector<KM_3fVector> m_N;
    /// Texture coordinates: none, or one per vertex.
    std::vector<KM_2fPoint> m_T;
    /// Vertex colours: none, or one per vertex.
    std::vector<KM_Color> m_C;
    /// Triangles.
    std::vector<KM_MeshTriangle> m_F;

    int VertexCount() const { return static_cast<int>(m_V.size()); }
    int TriangleCount() const { return static_cast<int>(m_F.size()); }

    /// True when there is a triangle, every index names a vertex, every vertex, normal and texture
    /// coordinate is finite, the optional arrays are empty or as long as the vertices, and the
    /// counts fit an int.
    /// @param why  receives an English sentence that says what is wrong first and where (vertices
    ///             and triangles counted from 0); emptied when the mesh is valid; may be null
    bool IsValid(KM_wString* why = nullptr) const;

    /// The box of all vertices with finite coordinates, those of no triangle too; empty when there
    /// are none.
    KM_BoundingBox BoundingBox() const;

    /// Replaces the normals: at each vertex the sum of the normals of its triangles, each weighted
    /// by its angle there (G. Thuermer and C. Wuethrich, "Computing Vertex Normals from Polygonal
    /// Facets", Journal of Graphics Tools 3(1), 1998). A vertex of no proper triangle gets +Z.
    /// Triangles with an index outside the mesh are passed over.
    void ComputeVertexNormals();

    /// Moves the vertices by the matrix and turns the normals with them (by the inverse
    /// transpose). A matrix that mirrors also turns every triangle round, so that its outside
    /// stays outside.
    /// @return false, with the mesh unchanged, when the matrix is invalid, cannot be inverted, or
    ///         would send a vertex to infinity
    bool Transform(const KM_Xform& xform);

    /// Adds the vertices and triangles of `other`, which may be this very mesh. An optional array
    /// that only one of the two has is dropped, but colours are filled with white and normals
    /// computed where they are missing.
    /// @return false, with the mesh unchanged, when there would be more than 2^31 - 1 vertices or
    ///         triangles
    bool Append(const KM_Mesh& other);

    /// Empties all arrays and frees their storage.
    void Clear();

    /// Makes sure that 4 bytes beyond the last vertex can be read. The ray tracer loads a vertex as
    /// 16 bytes although it has 12. Call it once the vertices are complete and before they are
    /// shared; later changes of m_V undo it, and so does copying the mesh.
    void PadForRayTracing();
};
