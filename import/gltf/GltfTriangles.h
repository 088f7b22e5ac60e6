#pragma once

#include "import/gltf/GltfDeformation.h"
#include "import/gltf/GltfMaterials.h"

#include <cstdint>
#include <memory>

namespace quarn::gltf {

/// How many triangles so many corners make.
std::uint64_t trianglesOf(PrimitiveMode mode, std::uint64_t corners);

/// Triangles, without those that cannot be shown.
struct ReadTriangles {
    std::shared_ptr<KM_Mesh> mesh; ///< every vertex is used and finite
    std::uint64_t in_range = 0;    ///< triangles whose indices name vertices
};

/// @param primitive  of triangles
ReadTriangles readTrianglesOf(const Primitive& primitive, const Deformation& deformation,
                              const TexturePlace& texture_place);

} // namespace quarn::gltf
