#pragma once

#include "kelmar/KM_Mesh.h"

namespace quarn {

/// Gives every vertex a normal: the mean of the normals of the triangles that meet there, as far as
/// they lie within the crease angle of each other. A vertex on a sharper edge is split, so that the
/// edge stays sharp. Vertices that only share their place (a seam of the texture) are smoothed
/// together. The mean is weighted after Nelson Max, "Weights for Computing Vertex Normals from
/// Facet Normals", Journal of Graphics Tools 4(2), 1999, equation 2, so that it does not depend on
/// how a flat face was cut into triangles.
///
/// @param mesh               valid, without normals
/// @param crease_angle_deg   between 0 and 180
void smoothVertexNormals(KM_Mesh& mesh, double crease_angle_deg);

/// Gives each vertex whose normal is zero the mean of the normals of its triangles.
///
/// @param mesh  valid, with a normal for each vertex
void fillMissingNormals(KM_Mesh& mesh);

} // namespace quarn
