#pragma once

#include "engine/scene/Material.h"
#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Xform.h"

#include <memory>

namespace quarn {

/// A mesh with what it looks like and where it stands. Reader, document and ray scene share one and
/// never change it.
struct PlacedMesh {
    std::shared_ptr<const KM_Mesh> mesh{};
    std::shared_ptr<const Material> material{}; ///< null: the default material
    /// Objects may share a mesh, and one that lies far from the origin keeps its digits by
    /// coordinates of its own. Affine and not flattening.
    KM_Xform world_from_mesh{};

    /// The box of the mesh in the world: exact, and empty for a mesh without a finite vertex. Looks
    /// at every vertex only where the transform turns the mesh. There must be a mesh.
    KM_BoundingBox box() const;
    /// The same, where the box of the mesh's own coordinates is known already.
    KM_BoundingBox box(const KM_BoundingBox& own_box) const;
};

/// A place near which single precision is enough for what lies in a box: the origin of the world
/// unless the box lies more than a hundred times its size away from it, else a round place nearby.
/// Floats carry seven digits; those that all coordinates of a far model share would be wasted.
KM_3dPoint nearbyOrigin(const KM_BoundingBox& box);

} // namespace quarn
