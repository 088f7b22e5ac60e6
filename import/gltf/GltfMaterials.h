#pragma once

#include "engine/scene/Material.h"
#include "import/gltf/GltfBuffers.h"
#include "import/textures/TextureStore.h"

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace quarn::gltf {

/// Where a texture coordinate of a mesh lies on the texture: u' = u[0] u + u[1] v + u[2], and v'
/// with the numbers of v. Both v run upward from the lower border; those of files run downward.
struct TexturePlace {
    double u[3] = {1, 0, 0};
    double v[3] = {0, -1, 1};
};

/// A material of the file, and what a mesh must know of it.
struct ReadMaterial {
    std::shared_ptr<Material> material;
    std::uint64_t coordinate_set = 0; ///< which texture coordinates its texture uses
    TexturePlace texture_place;
    bool blends = false; ///< the alpha of vertices counts
};

/// Makes the materials of a file on demand, each once, with the textures that they name. A texture
/// that cannot be had is left out, and a sentence says so.
class Materials {
public:
    /// All that it refers to outlives this object.
    /// @param warnings  receives sentences
    Materials(const ModelReading& reading, const Json& json, Buffers& buffers,
              std::vector<std::string>& warnings)
        : m_json(json), m_buffers(buffers), m_textures(reading, warnings), m_warnings(warnings) {}

    /// @param which  the number of the material, as the file has it; null: the default material
    const ReadMaterial& at(const Json& which);

private:
    ReadMaterial read(const Json& json);
    void readTexture(const Json& reference, ReadMaterial& result);
    void readAlpha(const Json& json, ReadMaterial& result) const;
    std::shared_ptr<const Texture> texture(const Json& texture, std::uint64_t index);
    std::shared_ptr<const Texture> image(std::uint64_t index, TextureWraps wraps);

    const Json& m_json;
    Buffers& m_buffers;
    TextureStore m_textures;
    std::vector<std::string>& m_warnings;
    std::map<std::optional<std::uint64_t>, ReadMaterial> m_materials;
};

} // namespace quarn::gltf
