#pragma once

#include "import/TexturePlace.h"
#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Xform.h"

#include <cstddef>
#include <memory>

struct aiMesh;

namespace quarn {

/// How one mesh of a model file becomes a mesh of ours.
struct MeshReading {
    KM_Xform world_from_mesh;
    bool keep_normals = true;         ///< false: the file's normals say no more than its triangles
    bool linear_colors = false;       ///< vertex colours are linear light, not sRGB
    unsigned texture_coordinates = 0; ///< which set of the mesh to take
    TexturePlace texture_place;       ///< where its coordinates lie on the texture
};

struct ConvertedMesh {
    std::shared_ptr<KM_Mesh> mesh; ///< may be without triangles
    std::size_t triangles_dropped =
        0; ///< index out of range, or a coordinate that is no usable number
};

/// The triangles of `mesh` in world coordinates, with the normals of the file if it has any. Only
/// vertices that a triangle uses are kept; where no two polygons share a vertex, equal ones are
/// made one. The result wants completeMesh(), which no longer needs the source.
ConvertedMesh convertTriangles(const aiMesh& mesh, const MeshReading& reading);

/// Gives each vertex that has none its normal, and releases memory that was only kept in reserve.
void completeMesh(KM_Mesh& mesh);

/// False when the corners of each triangle lie on a line or at one place, but for rounding.
bool hasArea(const KM_Mesh& mesh);

/// True for a coordinate that a mesh can hold: a number of single precision. Whether it can be
/// drawn is another question, see engine/scene/DrawableRange.h.
bool isUsableCoordinate(double coordinate);

} // namespace quarn
