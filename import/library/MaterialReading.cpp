#include "import/library/MaterialReading.h"

#include "import/assembly/StoredColor.h"
#include "import/textures/TextureTransparency.h"

#include <assimp/GltfMaterial.h>
#include <assimp/material.h>
#include <assimp/mesh.h>
#include <assimp/scene.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <initializer_list>
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

/// Where the glTF extension KHR_texture_transform puts a texture: coordinates are scaled, turned
/// and moved, with v running downward from the upper border. The reading library keeps scale and
/// angle, the angle with its sign turned, and has added to the offset what would make up for a turn
/// about the middle of the picture; that is taken off again.
TexturePlace texturePlaceOf(const aiMaterial& source) {
    aiUVTransform read;
    if (source.Get(AI_MATKEY_UVTRANSFORM(aiTextureType_BASE_COLOR, 0), read) != aiReturn_SUCCESS) {
        return {};
    }
    const double angle = -static_cast<double>(read.mRotation);
    const double scale_u = static_cast<double>(read.mScaling.x);
    const double scale_v = static_cast<double>(read.mScaling.y);
    const double cosine = std::cos(angle);
    const double sine = std::sin(angle);
    const double offset_u =
        static_cast<double>(read.mTranslation.x) - 0.5 * scale_u * (1.0 - cosine + sine);
    const double offset_v = 0.5 * scale_v * (sine + cosine - 1.0) + 1.0 - scale_v -
                            static_cast<double>(read.mTranslation.y);
    // Ours run upward from the lower border: 1 - v goes in, 1 - v comes out.
    return {{cosine * scale_u, -sine * scale_v, offset_u + sine * scale_v},
            {sine * scale_u, cosine * scale_v, 1.0 - offset_v - cosine * scale_v}};
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

bool isSeeThrough(const aiMesh& mesh) {
    return mesh.mColors[0] != nullptr &&
           std::any_of(mesh.mColors[0], mesh.mColors[0] + mesh.mNumVertices,
                       [](const aiColor4D& color) { return color.a < 1.0F; });
}

bool hasSeeThroughVertices(const aiScene& scene, const aiMaterial& material) {
    const std::span meshes(scene.mMeshes, scene.mNumMeshes);
    return std::any_of(meshes.begin(), meshes.end(), [&](const aiMesh* mesh) {
        return mesh->mMaterialIndex < scene.mNumMaterials &&
               scene.mMaterials[mesh->mMaterialIndex] == &material && isSeeThrough(*mesh);
    });
}

void readAlphaCutoff(const aiMaterial& source, Material& material) {
    material.alpha_cutout = true;
    source.Get(AI_MATKEY_GLTF_ALPHACUTOFF, material.alpha_cutoff);
    const float cutoff = material.alpha_cutoff;
    material.alpha_cutoff = std::isfinite(cutoff) ? std::clamp(cutoff, 0.0F, 1.0F) : 0.5F;
}

/// Whether the surface has holes or is see-through, where the file says that its alpha counts.
void readAlpha(const aiScene& scene, const aiMaterial& source, Material& material) {
    aiString mode;
    const bool has_mode = source.Get(AI_MATKEY_GLTF_ALPHAMODE, mode) == aiReturn_SUCCESS;
    const std::string_view name = mode.C_Str();
    if (name == "MASK") {
        readAlphaCutoff(source, material);
        return;
    }
    if (has_mode && name != "BLEND") {
        return;
    }
    const bool texture_counts = has_mode || source.GetTextureCount(aiTextureType_OPACITY) > 0;
    const Transparency of_texture = texture_counts && material.base_color_texture != nullptr
                                        ? transparencyOf(*material.base_color_texture)
                                        : Transparency::none;
    // Many programs write an opacity of 0 where they mean that there is none to write.
    const bool is_dimmed = material.base_color.a < 255 && (has_mode || material.base_color.a > 0);
    material.see_through = is_dimmed || of_texture == Transparency::partial ||
                           (has_mode && hasSeeThroughVertices(scene, source));
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
                                 bool linear_colors, std::vector<std::string>& warnings)
    : m_scene(scene), m_linear_colors(linear_colors), m_textures(reading, warnings) {}

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
    const bool made_up = text == AI_DEFAULT_MATERIAL_NAME || text.empty();
    if (made_up && source.GetTextureCount(aiTextureType_DIFFUSE) == 0 && !m_linear_colors) {
        return result;
    }
    result.material = std::make_shared<Material>();
    result.material->name = KM_wString::FromUtf8(text);
    const aiColor4D c = baseColorOf(source);
    result.material->base_color =
        m_linear_colors ? colorFromLinear(c.r, c.g, c.b, c.a) : colorFromSrgb(c.r, c.g, c.b, c.a);
    readTexture(source, result);
    readOpacityMap(source, result);
    readAlpha(m_scene, source, *result.material);
    return result;
}

void MaterialReading::readTexture(const aiMaterial& source, ReadMaterial& result) {
    TextureReference reference;
    if (!findTexture(source, {aiTextureType_BASE_COLOR, aiTextureType_DIFFUSE}, reference)) {
        return;
    }
    Material& material = *result.material;
    result.texture_coordinates = reference.coordinates;
    result.texture_place = m_linear_colors ? texturePlaceOf(source) : TexturePlace();
    material.base_color_texture =
        texture(reference.name, {wrapOf(reference.modes[0]), wrapOf(reference.modes[1])});
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
}

std::shared_ptr<const Texture> MaterialReading::texture(const std::string& reference,
                                                        TextureWraps wraps) {
    const aiTexture* embedded = m_scene.GetEmbeddedTexture(reference.c_str());
    if (embedded == nullptr || embedded->pcData == nullptr) {
        return m_textures.fromFile(reference, wraps);
    }
    if (embedded->mHeight > 0) {
        return m_textures.keep(reference, textureFromPixels(*embedded), wraps);
    }
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(embedded->pcData);
    return m_textures.fromBytes(reference, {bytes, embedded->mWidth}, wraps);
}

} // namespace quarn
