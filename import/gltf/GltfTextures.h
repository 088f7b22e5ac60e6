#pragma once

#include "import/gltf/GltfBuffers.h"
#include "import/textures/TexturePlace.h"
#include "import/textures/TextureStore.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace quarn::gltf {

/// What a material says of one of its textures.
struct TextureReference {
    std::uint64_t index = 0;          ///< which texture of the file
    std::uint64_t coordinate_set = 0; ///< which texture coordinates it uses
    TexturePlace place; ///< turned round: the v of files runs downward, and comes out upward
};

/// @param reference  JSON
/// @return nothing where it names no texture
std::optional<TextureReference> referenceOf(const Json& reference);

/// The textures of a file, each read once. One that cannot be had is left out, and a sentence says
/// so.
class Textures {
public:
    /// All that it refers to outlives this object.
    /// @param warnings  receives sentences
    Textures(const ModelReading& reading, const Json& json, Buffers& buffers,
             std::vector<std::string>& warnings)
        : m_json(json), m_buffers(buffers), m_store(reading, warnings) {}

    /// @return null where it was left out
    std::shared_ptr<const Texture> at(std::uint64_t index);

    TextureStore& store() { return m_store; }

private:
    std::shared_ptr<const Texture> image(std::uint64_t index, TextureWraps wraps);

    const Json& m_json;
    Buffers& m_buffers;
    TextureStore m_store;
};

} // namespace quarn::gltf
