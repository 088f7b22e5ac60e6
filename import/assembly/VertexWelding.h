#pragma once

#include "kelmar/KM_Mesh.h"

namespace quarn {

/// Makes one of vertices with the same place, normal, texture coordinate and colour, so that
/// triangles which state their corners each for itself are smoothed where they meet.
///
/// @param mesh  valid; negative zeros count as others than positive ones
void weldVertices(KM_Mesh& mesh);

} // namespace quarn
