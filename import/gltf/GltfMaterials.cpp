#include "import/gltf/GltfMaterials.h"

#include "import/assembly/StoredColor.h"
#include "import/textures/TextureTransparency.h"

#include <algorithm>
#include <array>
#include <utility>

namespace quarn::gltf {

namespace {

KM_Color colorOf(const Json& factor) {
    std::array<double, 4> c{1.0, 1.0, 1.0, 1.0};
    readNumbers(factor, c);
    return colorFromLinear(static_cast<float>(c[0]), static_cast<float>(c[1]),
                           static_cast<float>(c[2]), static_cast<float>(c[3]));
}

/// The first of some things, and how many more there are.
std::string listOf(const std::vector<std::string>& things) {
    constexpr std::size_t MOST_NAMED = 3;
    std::string list;
    for (std::size_t i = 0; i < std::min(MOST_NAMED, things.size()); ++i)
        list += (i > 0 ? ", " : "") + things[i];
    if (things.size() > MOST_NAMED)
        list += " and " + std::to_string(things.size() - MOST_NAMED) + " more";
    return list;
}

} // namespace

const ReadMaterial& Materials::at(const Json& which) {
    const std::optional<std::uint64_t> index = wholeNumber(which);
    const auto found = m_materials.find(index);
    if (found != m_materials.end())
        return found->second;
    const Json& json = element(member(m_json, "materials"), index.value_or(UINT64_MAX));
    if (index && json.is_null())
        m_warnings.push_back("A mesh names material " + std::to_string(*index) +
                             ", which is not there; it is shown without.");
    return m_materials.emplace(index, read(json)).first->second;
}

ReadMaterial Materials::read(const Json& json) {
    ReadMaterial result;
    result.material = std::make_shared<Material>();
    result.material->name = KM_wString::FromUtf8(text(member(json, "name")));
    readSurface(json, *result.material);
    readBaseColor(json, result);
    readAlpha(json, result);
    for (const SurfaceTexture& texture : surfaceTextures(json, *result.material))
        readTexture(texture, result);
    const Json& glossiness = glossinessOf(json);
    if (!glossiness.is_null() && !result.material->is_unlit)
        readGlossyTexture(glossiness, result);
    return result;
}

void Materials::readBaseColor(const Json& json, ReadMaterial& result) {
    const Json& glossiness = glossinessOf(json);
    const bool is_glossy = !glossiness.is_null();
    const Json& source = is_glossy ? glossiness : member(json, "pbrMetallicRoughness");
    Material& material = *result.material;
    material.base_color = colorOf(member(source, is_glossy ? "diffuseFactor" : "baseColorFactor"));
    const auto reference =
        referenceOf(member(source, is_glossy ? "diffuseTexture" : "baseColorTexture"));
    if (!reference)
        return;
    material.base_color_texture = m_textures.at(reference->index);
    if (material.base_color_texture == nullptr)
        return;
    result.has_texture = true;
    result.coordinate_set = reference->coordinate_set;
    result.texture_place = reference->place;
}

/// Whether the surface has holes or is see-through.
void Materials::readAlpha(const Json& json, ReadMaterial& result) const {
    Material& material = *result.material;
    const std::string mode = text(member(json, "alphaMode"));
    if (mode == "MASK") {
        material.alpha_cutout = true;
        const double cutoff = number(member(json, "alphaCutoff"), 0.5);
        material.alpha_cutoff = static_cast<float>(std::clamp(cutoff, 0.0, 1.0));
    }
    result.blends = mode == "BLEND";
    if (!result.blends)
        return;
    const Transparency of_texture = material.base_color_texture != nullptr
                                        ? transparencyOf(*material.base_color_texture)
                                        : Transparency::none;
    material.see_through = material.base_color.a < 255 || of_texture == Transparency::partial;
    material.alpha_cutout = !material.see_through && of_texture == Transparency::holes;
}

/// A mesh has texture coordinates once: those of the base colour, else of the first other texture.
void Materials::readTexture(const SurfaceTexture& texture, ReadMaterial& result) {
    const auto reference = referenceOf(*texture.reference);
    if (!reference)
        return;
    Material& material = *result.material;
    TextureUse use;
    const bool is_elsewhere =
        result.has_texture && reference->coordinate_set != result.coordinate_set;
    if (is_elsewhere || !layTexture(result.texture_place, reference->place, use)) {
        m_laid_elsewhere.push_back("'" + material.name.ToUtf8() + "' (" + texture.name + ")");
        return;
    }
    use.texture = m_textures.at(reference->index);
    if (use.texture == nullptr)
        return;
    result.has_texture = true;
    result.coordinate_set = reference->coordinate_set;
    material.*texture.use = std::move(use);
}

/// Its colours are what the surface mirrors, its alpha is the glossiness.
void Materials::readGlossyTexture(const Json& glossiness, ReadMaterial& result) {
    Material& material = *result.material;
    const Json& reference = member(glossiness, "specularGlossinessTexture");
    readTexture({&reference, &Material::specular_color_texture, "specular colour and glossiness"},
                result);
    if (material.specular_color_texture.texture == nullptr)
        return;
    material.metal_rough = material.specular_color_texture;
    material.metal_rough.texture = m_textures.store().roughness(
        material.specular_color_texture.texture, 1.0F - material.roughness);
    material.roughness = 1.0F;
}

void Materials::tellLosses() {
    if (!m_laid_elsewhere.empty())
        m_warnings.push_back("Textures of materials were left out, as they lie by other texture "
                             "coordinates than the base colour: " +
                             listOf(m_laid_elsewhere) + ".");
    const auto sheens = std::ranges::count_if(m_materials, [](const auto& of_number) {
        return of_number.second.material->sheen_color != LinearRgb{0, 0, 0};
    });
    if (sheens > 0)
        m_warnings.push_back("The sheen of " + std::to_string(sheens) +
                             (sheens > 1 ? " materials is kept, but not drawn."
                                         : " material is kept, but not drawn."));
}

} // namespace quarn::gltf
