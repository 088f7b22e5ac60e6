#pragma once

#include "import/ModelReading.h"
#include "import/gltf/GltfJson.h"

#include <string_view>

namespace quarn::gltf {

/// The parts of a .gltf or .glb file.
struct Container {
    std::string_view text;   ///< JSON
    Bytes binary;            ///< of a GLB: what its first buffer holds; may be empty
    bool is_old_glb = false; ///< a GLB of version 1; then nothing else is set
};

/// Takes a file apart; whether it is binary is told by its first bytes, whatever its name says.
/// @return an error, a part of a sentence
Result<Container> takeApart(const ModelReading& reading);

/// The error for a file that cannot be what it claims to be.
/// @param why  a part of a sentence
Error damaged(const ModelReading& reading, std::string_view why);
/// The error for a file whose content the budget does not hold.
Error tooLarge(const ModelReading& reading, std::string_view why);

/// Takes a share of the budget; a product beyond 64 bits is more than any budget holds.
/// @param what  what the memory is for, in the plural
/// @return an error that names the file
Result<void> takeMemory(const ModelReading& reading, std::uint64_t count, std::uint64_t bytes_each,
                        std::string_view what);

} // namespace quarn::gltf
