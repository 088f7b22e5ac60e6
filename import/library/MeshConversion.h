#pragma once

#include "kelmar/KM_Mesh.h"

#include <cstddef>
#include <memory>

struct aiMesh;

namespace quarn {

/// How one mesh of a model file becomes a mesh of ours.
struct MeshReading {
    bool keep_normals = true;         ///< false: the file's normals say no more than its triangles
    unsigned texture_coordinates = 0; ///< which set of the mesh to take
};

struct ConvertedMesh {
    std::shared_ptr<KM_Mesh> mesh; ///< may be without triangles
    std::size_t triangles_dropped =
        0; ///< index out of range, or a coordinate that is no usable number
};

/// The triangles of `mesh`, with the normals of the file if it has any. Only vertices that a
/// triangle uses are kept; where no two polygons share a vertex, equal ones are made one.
ConvertedMesh convertTriangles(const aiMesh& mesh, const MeshReading& reading);

} // namespace quarn
