#pragma once

#include "kelmar/KM_Mesh.h"

#include <cstddef>

namespace quarn {

/// Takes away the triangles with a vertex whose coordinates are no usable numbers; such vertices
/// then lie at the origin.
/// @return how many triangles were
std::size_t dropUnusableTriangles(KM_Mesh& mesh);

/// Takes away the vertices of no triangle.
/// @param mesh  every index names a vertex
void dropUnusedVertices(KM_Mesh& mesh);

/// Makes vertices that are equal in all that they have one, which takes the place of the first.
/// @param mesh  every index names a vertex
void weldVertices(KM_Mesh& mesh);

/// The same for a mesh that may share fewer vertices than it could: in one whose triangles share
/// them there are half as many vertices as triangles, and where none is shared three times as many.
void weldSparseMesh(KM_Mesh& mesh);

} // namespace quarn
