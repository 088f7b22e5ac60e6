#pragma once

#include "import/ply/PlyContents.h"
#include "kelmar/KM_Mesh.h"

#include <array>
#include <cstdint>
#include <vector>

namespace quarn {

/// What connects the vertices of a file. Every index names a vertex.
struct PlyFaces {
    std::vector<KM_MeshTriangle> triangles;
    std::vector<KM_2fPoint>
        texture; ///< of each corner of each triangle; none where vertices have it
    std::vector<std::array<std::uint32_t, 2>> lines;
    std::vector<std::uint32_t> points;
    std::uint64_t without_corners = 0; ///< faces
};

/// True for an element that connects vertices: faces, strips of triangles, edges.
bool connectsVertices(const PlyElement& element);

/// Reads such an element. What is wrong is noted in `contents`.
/// @param kind      which of the elements
/// @param vertices  of the file; their places say how polygons are cut
/// @param faces     receives what the element holds
void readPlyFaces(PlyContents& contents, std::size_t kind, const std::vector<KM_3fPoint>& vertices,
                  PlyFaces& faces);

} // namespace quarn
