#pragma once

#include "engine/scene/Material.h"
#include "import/textures/TextureStore.h"

#include <assimp/material.h>

#include <initializer_list>
#include <map>
#include <memory>
#include <string>
#include <vector>

struct aiScene;
struct aiTexture;

namespace quarn {

/// A material of a model file, and what a mesh must know of it.
struct ReadMaterial {
    std::shared_ptr<Material> material; ///< null: the file gives none
    bool has_texture = false;
    unsigned texture_coordinates = 0; ///< the set that its textures use
};

/// Makes materials of a model file on demand, each once, with the textures that they name.
class MaterialReading {
public:
    /// @param scene     outlives this object, with its materials and textures
    /// @param reading   outlives this object
    /// @param warnings  receives a sentence for each texture that is left out; outlives this
    MaterialReading(const aiScene& scene, const ModelReading& reading,
                    std::vector<std::string>& warnings);

    const ReadMaterial& at(unsigned index);

private:
    ReadMaterial read(const aiMaterial& source);
    void readTexture(const aiMaterial& source, ReadMaterial& result);
    void readOpacityMap(const aiMaterial& source, ReadMaterial& result);
    void readSurfaceTextures(const aiMaterial& source, ReadMaterial& result);
    void readRelief(const aiMaterial& source, ReadMaterial& result);
    std::shared_ptr<const Texture> textureBeside(const aiMaterial& source,
                                                 std::initializer_list<aiTextureType> types,
                                                 ReadMaterial& result);
    std::shared_ptr<const Texture> texture(const std::string& reference, TextureWraps wraps);

    std::shared_ptr<const Texture> textureFromFile(const std::string& reference,
                                                   TextureWraps wraps);
    std::string firstThatIsThere(const std::string& reference) const;

    const aiScene& m_scene;
    const ModelFolder& m_folder;
    TextureStore m_textures;
    std::map<unsigned, ReadMaterial> m_materials;
};

} // namespace quarn
