#pragma once

#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Xform.h"

class KM_Mesh;

namespace quarn {

/// The box of a mesh where a transform puts it: exact, and empty for a mesh without a finite
/// vertex. Looks at every vertex only where the transform turns the mesh.
/// @param world_from_mesh  affine
KM_BoundingBox boxOfPlaced(const KM_Mesh& mesh, const KM_Xform& world_from_mesh);

/// A place near which single precision is enough for what lies in a box: the origin of the world
/// unless the box lies more than a hundred times its size away from it, else a round place nearby.
/// Floats carry seven digits; those that all coordinates of a far model share would be wasted.
KM_3dPoint nearbyOrigin(const KM_BoundingBox& box);

} // namespace quarn
