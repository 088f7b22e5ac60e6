#pragma once

#include "import/gltf/GltfAccessor.h"

#include <cstdint>
#include <map>
#include <string>

namespace quarn::gltf {

/// How many vertices and indices a compressed mesh may have: what its accessors claim.
struct DracoLimits {
    std::uint64_t vertices = 0;
    std::uint64_t indices = 0;
};

/// What stood in compressed bytes, in accessors that own it.
struct DracoMesh {
    std::map<std::string, Accessor> attributes;
    Accessor indices; ///< of triangles; not checked
};

/// Decodes what the extension KHR_draco_mesh_compression stores.
/// @param ids  the attributes by the numbers that they have in the bytes
/// @return an error, a part of a sentence
Result<DracoMesh> decodeDraco(Bytes bytes, const std::map<std::string, std::uint32_t>& ids,
                              const DracoLimits& limits);

} // namespace quarn::gltf
