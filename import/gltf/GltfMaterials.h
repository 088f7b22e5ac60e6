#pragma once

#include "engine/scene/Material.h"
#include "import/gltf/GltfSurface.h"
#include "import/gltf/GltfTextures.h"

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace quarn::gltf {

/// A material of the file, and what a mesh must know of it.
struct ReadMaterial {
    std::shared_ptr<Material> material;
    bool has_texture = false;
    std::uint64_t coordinate_set = 0; ///< which texture coordinates its textures use
    /// Where its base colour lies by them; v runs downward in files.
    TexturePlace texture_place{{1, 0, 0}, {0, -1, 1}};
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
        : m_json(json), m_textures(reading, json, buffers, warnings), m_warnings(warnings) {}

    /// @param which  the number of the material, as the file has it; null: the default material
    const ReadMaterial& at(const Json& which);

    /// Tells what of the materials that were asked for is not drawn.
    void tellLosses();

private:
    ReadMaterial read(const Json& json);
    void readBaseColor(const Json& json, ReadMaterial& result);
    void readAlpha(const Json& json, ReadMaterial& result) const;
    void readTexture(const SurfaceTexture& texture, ReadMaterial& result);
    void readGlossyTexture(const Json& glossiness, ReadMaterial& result);

    const Json& m_json;
    Textures m_textures;
    std::vector<std::string>& m_warnings;
    std::map<std::optional<std::uint64_t>, ReadMaterial> m_materials;
    std::vector<std::string> m_laid_elsewhere; ///< textures: "'brick' (occlusion)"
};

} // namespace quarn::gltf
