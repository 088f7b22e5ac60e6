#include "import/ply/PlyFaceRole.h"

#include <algorithm>
#include <string_view>

namespace quarn {

PlyFaceRole plyFaceRole(const PlyElement& element, const PlyProperty& property) {
    using Role = PlyFaceRole;
    const std::string_view name = property.name;
    const bool is_edge = element.name == "edge";
    if (property.isList() && !is_edge) {
        if (name == "vertex_indices" || name == "vertex_index")
            return Role::indices;
        return name == "texcoord" && element.name == "face" ? Role::texture : Role::nothing;
    }
    if (is_edge && !property.isList())
        return name == "vertex1"   ? Role::first_end
               : name == "vertex2" ? Role::second_end
                                   : Role::nothing;
    return Role::nothing;
}

bool hasPlyFaceRole(const PlyElement& element, PlyFaceRole role) {
    return std::ranges::any_of(element.properties, [&](const PlyProperty& property) {
        return plyFaceRole(element, property) == role;
    });
}

} // namespace quarn
