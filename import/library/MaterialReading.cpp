#include "import/library/MaterialReading.h"

#include "import/assembly/StoredColor.h"
#include "import/library/SurfaceNumbers.h"
#include "import/textures/DataPictures.h"
#include "import/textures/TextureTransparency.h"

#include <assimp/mesh.h>
#include <assimp/scene.h>

#include <algorithm>
#include <array>
#include <span>

namespace quarn {
namespace {

struct TextureReference {
    std::string name;
    unsigned coordinates = 0;
    std::array<aiTextureMapMode, 2> modes{aiTextureMapMode_Wrap, aiTextureMapMode_Wrap};
};

bool findTexture(const aiMaterial& source, std::initializer_list<aiTextureType> types,
                 TextureReference& reference) {
    for (const aiTextureType type : types) {
        aiString path;
        if (source.GetTexture(type, 0, &path, nullptr, &reference.coordinates, nullptr, nullptr,
                              reference.modes.data()) == aiReturn_SUCCESS &&
            path.length > 0) {
            reference.name = path.C_Str();
            return true;
        }
    }
    return false;
}

TextureWrap wrapOf(aiTextureMapMode mode) {
    if (mode == aiTextureMapMode_Mirror) {
        return TextureWrap::mirror;
    }
    const bool clamps = mode == aiTextureMapMode_Clamp || mode == aiTextureMapMode_Decal;
    return clamps ? TextureWrap::clamp : TextureWrap::repeat;
}

aiColor4D baseColorOf(const aiMaterial& source) {
    aiColor4D color(0.8F, 0.8F, 0.8F, 1.0F);
    if (source.Get(AI_MATKEY_BASE_COLOR, color) == aiReturn_SUCCESS) {
        return color;
    }
    source.Get(AI_MATKEY_COLOR_DIFFUSE, color);
    color.a = 1.0F;
    source.Get(AI_MATKEY_OPACITY, color.a);
    return color;
}

/// Whether the surface has holes or is see-through, where the file says that its alpha counts.
void readAlpha(const aiMaterial& source, Material& material) {
    const bool texture_counts = source.GetTextureCount(aiTextureType_OPACITY) > 0;
    const Transparency of_texture = texture_counts && material.base_color_texture != nullptr
                                        ? transparencyOf(*material.base_color_texture)
                                        : Transparency::none;
    // Many programs write an opacity of 0 where they mean that there is none to write.
    const bool is_dimmed = material.base_color.a < 255 && material.base_color.a > 0;
    material.see_through = is_dimmed || of_texture == Transparency::partial;
    material.alpha_cutout = !material.see_through && of_texture == Transparency::holes;
}

/// Pixels that the file holds as they are. The sizes were checked when the file was read.
std::shared_ptr<Texture> textureFromPixels(const aiTexture& source) {
    const std::size_t count = static_cast<std::size_t>(source.mWidth) * source.mHeight;
    auto texture = std::make_shared<Texture>();
    texture->width = static_cast<int>(source.mWidth);
    texture->height = static_cast<int>(source.mHeight);
    texture->rgba.reserve(4 * count);
    for (const aiTexel& texel : std::span(source.pcData, count)) {
        texture->rgba.insert(texture->rgba.end(), {texel.r, texel.g, texel.b, texel.a});
    }
    return texture;
}

} // namespace

MaterialReading::MaterialReading(const aiScene& scene, const ModelReading& reading,
                                 std::vector<std::string>& warnings)
    : m_scene(scene), m_folder(reading.folder), m_textures(reading, warnings) {}

const ReadMaterial& MaterialReading::at(unsigned index) {
    const auto found = m_materials.find(index);
    if (found != m_materials.end()) {
        return found->second;
    }
    ReadMaterial material;
    if (index < m_scene.mNumMaterials && m_scene.mMaterials[index] != nullptr) {
        material = read(*m_scene.mMaterials[index]);
    }
    return m_materials.emplace(index, std::move(material)).first->second;
}

ReadMaterial MaterialReading::read(const aiMaterial& source) {
    ReadMaterial result;
    aiString name;
    source.Get(AI_MATKEY_NAME, name);
    const std::string_view text(name.data, name.length);
    aiColor4D stated(0.0F, 0.0F, 0.0F, 0.0F);
    source.Get(AI_MATKEY_COLOR_DIFFUSE, stated);
    // What is nothing at all stands for a material that is missing.
    const bool is_empty = text.empty() && stated == aiColor4D(0.0F, 0.0F, 0.0F, 0.0F);
    const bool made_up = text == AI_DEFAULT_MATERIAL_NAME || is_empty;
    if (made_up && source.GetTextureCount(aiTextureType_DIFFUSE) == 0) {
        return result;
    }
    result.material = std::make_shared<Material>();
    result.material->name = KM_wString::FromUtf8(text);
    const aiColor4D c = baseColorOf(source);
    result.material->base_color = colorFromSrgb(c.r, c.g, c.b, c.a);
    readTexture(source, result);
    readOpacityMap(source, result);
    readAlpha(source, *result.material);
    readSurfaceNumbers(source, *result.material);
    readSurfaceTextures(source, result);
    readRelief(source, result);
    return result;
}

void MaterialReading::readTexture(const aiMaterial& source, ReadMaterial& result) {
    TextureReference reference;
    if (!findTexture(source, {aiTextureType_BASE_COLOR, aiTextureType_DIFFUSE}, reference)) {
        return;
    }
    Material& material = *result.material;
    result.texture_coordinates = reference.coordinates;
    material.base_color_texture =
        texture(reference.name, {wrapOf(reference.modes[0]), wrapOf(reference.modes[1])});
    result.has_texture = material.base_color_texture != nullptr;
    KM_Color& color = material.base_color;
    if (material.base_color_texture != nullptr && color.r == 0 && color.g == 0 && color.b == 0) {
        // Many programs write black where the texture alone gives the colour.
        color = {255, 255, 255, color.a};
    }
}

/// Material files of OBJ give the opacity in a picture of its own.
void MaterialReading::readOpacityMap(const aiMaterial& source, ReadMaterial& result) {
    TextureReference reference;
    if (!findTexture(source, {aiTextureType_OPACITY}, reference)) {
        return;
    }
    const auto opacity =
        texture(reference.name, {wrapOf(reference.modes[0]), wrapOf(reference.modes[1])});
    std::shared_ptr<const Texture>& colors = result.material->base_color_texture;
    if (opacity == nullptr) {
        return;
    }
    if (colors == nullptr) {
        result.texture_coordinates = reference.coordinates;
    }
    colors = m_textures.combined(colors, opacity);
    result.has_texture = true;
}

/// As in material files of OBJ, a picture stands in place of a number.
void MaterialReading::readSurfaceTextures(const aiMaterial& source, ReadMaterial& result) {
    Material& material = *result.material;
    const auto roughness = textureBeside(source, {aiTextureType_DIFFUSE_ROUGHNESS}, result);
    const auto metalness = textureBeside(source, {aiTextureType_METALNESS}, result);
    material.metal_rough.texture = m_textures.metalRough(roughness, metalness);
    if (roughness != nullptr)
        material.roughness = 1.0F;
    if (metalness != nullptr)
        material.metalness = 1.0F;
    material.occlusion.texture = textureBeside(source, {aiTextureType_AMBIENT_OCCLUSION}, result);
    material.emission_texture.texture =
        textureBeside(source, {aiTextureType_EMISSION_COLOR, aiTextureType_EMISSIVE}, result);
    if (material.emission_texture.texture != nullptr && material.emission == LinearRgb{0, 0, 0})
        material.emission = {1.0F, 1.0F, 1.0F};
}

void MaterialReading::readRelief(const aiMaterial& source, ReadMaterial& result) {
    Material& material = *result.material;
    material.normals.texture =
        textureBeside(source, {aiTextureType_NORMALS, aiTextureType_NORMAL_CAMERA}, result);
    if (material.normals.texture != nullptr)
        return;
    const auto relief = textureBeside(source, {aiTextureType_HEIGHT}, result);
    TextureReference reference;
    if (relief == nullptr || !findTexture(source, {aiTextureType_HEIGHT}, reference))
        return;
    if (holdsNormals(*relief))
        material.normals.texture = relief;
    else
        m_textures.warnLeftOut(reference.name, HEIGHTS_NOT_DRAWN);
}

/// A mesh has texture coordinates once: those of the base colour, else of the first other texture.
std::shared_ptr<const Texture>
MaterialReading::textureBeside(const aiMaterial& source, std::initializer_list<aiTextureType> types,
                               ReadMaterial& result) {
    TextureReference reference;
    if (!findTexture(source, types, reference))
        return nullptr;
    if (result.has_texture && reference.coordinates != result.texture_coordinates) {
        m_textures.warnLeftOut(reference.name,
                               "it lies by other texture coordinates than the base colour");
        return nullptr;
    }
    auto found = texture(reference.name, {wrapOf(reference.modes[0]), wrapOf(reference.modes[1])});
    if (found != nullptr) {
        result.has_texture = true;
        result.texture_coordinates = reference.coordinates;
    }
    return found;
}

std::shared_ptr<const Texture> MaterialReading::texture(const std::string& reference,
                                                        TextureWraps wraps) {
    const aiTexture* embedded = m_scene.GetEmbeddedTexture(reference.c_str());
    if (embedded == nullptr || embedded->pcData == nullptr) {
        return textureFromFile(reference, wraps);
    }
    if (embedded->mHeight > 0) {
        return m_textures.keep(reference, textureFromPixels(*embedded), wraps);
    }
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(embedded->pcData);
    return m_textures.fromBytes(reference, {bytes, embedded->mWidth}, wraps);
}

std::shared_ptr<const Texture> MaterialReading::textureFromFile(const std::string& reference,
                                                                TextureWraps wraps) {
    constexpr std::string_view COMPUTED = "Procedural,";
    if (reference.starts_with("$")) // the reading library's own word for a texture without a name
        return nullptr;
    if (reference.starts_with(COMPUTED)) {
        m_textures.warnLeftOut(reference.substr(reference.rfind('=') + 1),
                               "it is a pattern to be computed, not a picture");
        return nullptr;
    }
    return m_textures.fromFile(firstThatIsThere(reference), wraps);
}

/// X3D names one texture by several addresses, each in quotes: the first that can be had counts.
std::string MaterialReading::firstThatIsThere(const std::string& reference) const {
    std::string first;
    for (std::size_t begin = 0; begin < reference.size();) {
        const std::size_t end = std::min(reference.find('"', begin), reference.size());
        const std::string address = reference.substr(begin, end - begin);
        begin = end + 1;
        if (address.find_first_not_of(' ') == std::string::npos)
            continue;
        if (m_folder.find(address))
            return address;
        first = first.empty() ? address : first;
    }
    return first;
}

} // namespace quarn
