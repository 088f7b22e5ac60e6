#pragma once

#include "kelmar/KM_Mesh.h"

namespace quarn {

/// Takes away the vertices that no triangle uses.
void dropUnusedVertices(KM_Mesh& mesh);

/// Lets triangles share the vertices that are alike in all that the mesh has (place, normal,
/// texture coordinate, colour), and takes away those that none uses.
void weldVertices(KM_Mesh& mesh);

} // namespace quarn
