#include "import/gltf/GltfMaterials.h"

#include "import/assembly/StoredColor.h"
#include "import/textures/TextureTransparency.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <utility>

namespace quarn::gltf {

namespace {

/// Khronos Group, glTF 2.0, section 5.26 (samplers).
TextureWrap wrapOf(const Json& mode) {
    constexpr std::uint64_t CLAMP = 33071;
    constexpr std::uint64_t MIRROR = 33648;
    const std::uint64_t value = wholeNumber(mode).value_or(0);
    if (value == CLAMP)
        return TextureWrap::clamp;
    return value == MIRROR ? TextureWrap::mirror : TextureWrap::repeat;
}

/// The extension KHR_texture_transform scales coordinates, turns and moves them, with v running
/// downward: 1 - v comes out.
TexturePlace placeOf(const Json& transform) {
    std::array<double, 2> offset{0.0, 0.0};
    std::array<double, 2> scale{1.0, 1.0};
    readNumbers(member(transform, "offset"), offset);
    readNumbers(member(transform, "scale"), scale);
    const double angle = number(member(transform, "rotation"), 0.0);
    const double cosine = std::cos(angle);
    const double sine = std::sin(angle);
    return {{cosine * scale[0], sine * scale[1], offset[0]},
            {sine * scale[0], -cosine * scale[1], 1.0 - offset[1]}};
}

KM_Color colorOf(const Json& factor) {
    std::array<double, 4> c{1.0, 1.0, 1.0, 1.0};
    readNumbers(factor, c);
    return colorFromLinear(static_cast<float>(c[0]), static_cast<float>(c[1]),
                           static_cast<float>(c[2]), static_cast<float>(c[3]));
}

std::string nameOfImage(const Json& image, std::uint64_t index) {
    const std::string uri = text(member(image, "uri"));
    const std::string file = uri.starts_with("data:") ? std::string() : uri;
    const std::string own = text(member(image, "name"));
    const std::string number = "image " + std::to_string(index);
    const std::string& name = file.empty() ? own : file;
    return name.empty() ? number : name + " (" + number + ")";
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
    Material& material = *result.material;
    material.name = KM_wString::FromUtf8(text(member(json, "name")));
    const Json& glossiness = extension(json, "KHR_materials_pbrSpecularGlossiness");
    const Json& roughness = member(json, "pbrMetallicRoughness");
    const bool is_glossy = !glossiness.is_null();
    material.base_color = colorOf(is_glossy ? member(glossiness, "diffuseFactor")
                                            : member(roughness, "baseColorFactor"));
    readTexture(is_glossy ? member(glossiness, "diffuseTexture")
                          : member(roughness, "baseColorTexture"),
                result);
    readAlpha(json, result);
    return result;
}

void Materials::readTexture(const Json& reference, ReadMaterial& result) {
    const auto index = wholeNumber(member(reference, "index"));
    if (!index)
        return;
    const Json& transform = extension(reference, "KHR_texture_transform");
    const Json& own_set = member(transform, "texCoord");
    result.coordinate_set =
        wholeNumber(own_set.is_null() ? member(reference, "texCoord") : own_set).value_or(0);
    result.texture_place = placeOf(transform);
    result.material->base_color_texture =
        texture(element(member(m_json, "textures"), *index), *index);
}

std::shared_ptr<const Texture> Materials::texture(const Json& texture, std::uint64_t index) {
    const Json& sampler = element(member(m_json, "samplers"),
                                  wholeNumber(member(texture, "sampler")).value_or(UINT64_MAX));
    const TextureWraps wraps{wrapOf(member(sampler, "wrapS")), wrapOf(member(sampler, "wrapT"))};
    if (const auto source = wholeNumber(member(texture, "source")))
        return image(*source, wraps);
    for (const char* const kind : {"EXT_texture_webp", "EXT_texture_avif", "KHR_texture_basisu"})
        if (const auto source = wholeNumber(member(extension(texture, kind), "source")))
            return image(*source, wraps);
    m_textures.warnLeftOut("texture " + std::to_string(index),
                           "the file does not say which picture it is");
    return nullptr;
}

std::shared_ptr<const Texture> Materials::image(std::uint64_t index, TextureWraps wraps) {
    const Json& image = element(member(m_json, "images"), index);
    const std::string name = nameOfImage(image, index);
    const std::string uri = text(member(image, "uri"));
    const auto view = wholeNumber(member(image, "bufferView"));
    if (!view && !uri.empty() && !uri.starts_with("data:"))
        return m_textures.fromFile(uri, wraps);
    if (!view && uri.empty()) {
        m_textures.warnLeftOut(name, "the file does not hold it");
        return nullptr;
    }
    if (const auto known = m_textures.known(name, wraps))
        return *known;
    const Result<Bytes> bytes = view ? m_buffers.view(*view) : m_buffers.fromDataUri(name, uri);
    if (bytes)
        return m_textures.fromBytes(name, bytes.value(), wraps);
    m_textures.warnLeftOut(name, "its bytes are not there");
    return nullptr;
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

} // namespace quarn::gltf
