#include "import/gltf/GltfTextures.h"

#include <array>
#include <cmath>

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
TexturePlace placeOfTexture(const Json& transform) {
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

std::string nameOfImage(const Json& image, std::uint64_t index) {
    const std::string uri = text(member(image, "uri"));
    const std::string file = uri.starts_with("data:") ? std::string() : uri;
    const std::string own = text(member(image, "name"));
    const std::string number = "image " + std::to_string(index);
    const std::string& name = file.empty() ? own : file;
    return name.empty() ? number : name + " (" + number + ")";
}

} // namespace

std::optional<TextureReference> referenceOf(const Json& reference) {
    const auto index = wholeNumber(member(reference, "index"));
    if (!index)
        return std::nullopt;
    const Json& transform = extension(reference, "KHR_texture_transform");
    const Json& own_set = member(transform, "texCoord");
    const Json& set = own_set.is_null() ? member(reference, "texCoord") : own_set;
    return TextureReference{*index, wholeNumber(set).value_or(0), placeOfTexture(transform)};
}

std::shared_ptr<const Texture> Textures::at(std::uint64_t index) {
    const Json& texture = element(member(m_json, "textures"), index);
    const Json& sampler = element(member(m_json, "samplers"),
                                  wholeNumber(member(texture, "sampler")).value_or(UINT64_MAX));
    const TextureWraps wraps{wrapOf(member(sampler, "wrapS")), wrapOf(member(sampler, "wrapT"))};
    if (const auto source = wholeNumber(member(texture, "source")))
        return image(*source, wraps);
    for (const char* const kind : {"EXT_texture_webp", "EXT_texture_avif", "KHR_texture_basisu"})
        if (const auto source = wholeNumber(member(extension(texture, kind), "source")))
            return image(*source, wraps);
    m_store.warnLeftOut("texture " + std::to_string(index),
                        "the file does not say which picture it is");
    return nullptr;
}

std::shared_ptr<const Texture> Textures::image(std::uint64_t index, TextureWraps wraps) {
    const Json& image = element(member(m_json, "images"), index);
    const std::string name = nameOfImage(image, index);
    const std::string uri = text(member(image, "uri"));
    const auto view = wholeNumber(member(image, "bufferView"));
    if (!view && !uri.empty() && !uri.starts_with("data:"))
        return m_store.fromFile(uri, wraps);
    if (!view && uri.empty()) {
        m_store.warnLeftOut(name, "the file does not hold it");
        return nullptr;
    }
    if (const auto known = m_store.known(name, wraps))
        return *known;
    const Result<Bytes> bytes = view ? m_buffers.view(*view) : m_buffers.fromDataUri(name, uri);
    if (bytes)
        return m_store.fromBytes(name, bytes.value(), wraps);
    m_store.warnLeftOut(name, "its bytes are not there");
    return nullptr;
}

} // namespace quarn::gltf
