#pragma once

#include "engine/scene/Material.h"
#include "import/files/ModelFolder.h"
#include "import/textures/TexturePlace.h"

#include <map>
#include <memory>
#include <set>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

struct aiMaterial;
struct aiScene;
struct aiTexture;

namespace quarn {

/// A material of a model file, and what a mesh must know of it.
struct ReadMaterial {
    std::shared_ptr<Material> material; ///< null: the file gives none
    unsigned texture_coordinates = 0;   ///< the set that its texture uses
    TexturePlace texture_place;
};

/// Makes materials of a model file on demand, each once, with the textures that they name.
class MaterialReading {
public:
    /// @param scene          outlives this object, with its materials and textures
    /// @param folder         outlives this object
    /// @param linear_colors  the file's base colours are linear light
    /// @param warnings       receives a sentence for each texture that is left out; outlives this
    MaterialReading(const aiScene& scene, const ModelFolder& folder, bool linear_colors,
                    std::vector<std::string>& warnings);

    const ReadMaterial& at(unsigned index);

private:
    using TextureKey = std::tuple<std::string, TextureWrap, TextureWrap>;

    ReadMaterial read(const aiMaterial& source);
    void readTexture(const aiMaterial& source, ReadMaterial& result);
    void readOpacityMap(const aiMaterial& source, ReadMaterial& result);
    std::shared_ptr<const Texture> texture(const TextureKey& key);
    std::shared_ptr<Texture> load(const std::string& reference);
    std::shared_ptr<Texture> loadFile(const std::string& reference);
    void warnLeftOut(const std::string& reference, const std::string& why);

    const aiScene& m_scene;
    const ModelFolder& m_folder;
    bool m_linear_colors;
    std::vector<std::string>& m_warnings;
    std::map<unsigned, ReadMaterial> m_materials;
    std::map<TextureKey, std::shared_ptr<const Texture>> m_textures;
    using TexturePair = std::pair<std::shared_ptr<const Texture>, std::shared_ptr<const Texture>>;
    std::map<TexturePair, std::shared_ptr<const Texture>>
        m_with_opacity;           ///< by colours and opacity
    std::set<std::string> m_told; ///< textures that were left out
};

} // namespace quarn
