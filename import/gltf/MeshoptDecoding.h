#pragma once

#include "ground/Result.h"

#include <cstdint>
#include <span>
#include <string>
#include <vector>

namespace quarn::gltf {

/// What the extension EXT_meshopt_compression says of compressed bytes.
struct MeshoptLayout {
    std::uint64_t count = 0;  ///< of elements
    std::uint64_t stride = 0; ///< bytes an element
    std::string mode;         ///< ATTRIBUTES, TRIANGLES or INDICES
    std::string filter;       ///< empty or NONE, OCTAHEDRAL, QUATERNION or EXPONENTIAL
};

/// Why no bytes can have such a layout, a part of a sentence; empty where they can. Their size,
/// count times stride, is then a number of 64 bits.
std::string whyBad(const MeshoptLayout& layout);

/// Decodes bytes whose layout is not bad.
/// @return count times stride bytes, of which the values are not checked; or an error, a part of a
///   sentence
Result<std::vector<std::uint8_t>> decodeMeshopt(std::span<const std::uint8_t> bytes,
                                                const MeshoptLayout& layout);

} // namespace quarn::gltf
