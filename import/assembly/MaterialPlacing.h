#pragma once

#include "import/assembly/SourceScene.h"

#include <compare>
#include <map>
#include <memory>
#include <utility>

namespace quarn {

/// Makes the materials of a scene such as can be drawn, and adds one sentence about those that were
/// not. What shared a material shares it still.
void repairMaterials(SourceScene& scene);

/// Materials where their meshes stand: lengths inside of what is see-through grow with the mesh. Of
/// the others, which have no lengths, each stays what it is.
class PlacedMaterials {
public:
    using Shared = std::shared_ptr<const Material>;

    /// For a mesh that keeps its coordinates.
    /// @param material  may be null, which it stays
    Shared ofShared(const Shared& material, const KM_Xform& world_from_mesh);
    /// For a mesh whose coordinates have become those of the world, or such that differ from them
    /// by where they begin.
    Shared ofMoved(const Shared& material, const KM_Xform& world_from_mesh);

private:
    struct Growth {
        float thickness = 1.0F;
        float distance = 1.0F;

        friend auto operator<=>(const Growth&, const Growth&) = default;
    };

    Shared grown(const Shared& material, Growth growth);

    std::map<std::pair<Shared, Growth>, Shared> m_grown;
};

} // namespace quarn
