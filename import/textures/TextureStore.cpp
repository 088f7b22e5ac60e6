#include "import/textures/TextureStore.h"

#include "import/textures/DataPictures.h"
#include "import/textures/OpacityMap.h"
#include "import/textures/TextureDecoding.h"

namespace quarn {

std::shared_ptr<const Texture> TextureStore::fromFile(const std::string& reference,
                                                      TextureWraps wraps) {
    const auto have = known(reference, wraps);
    return have ? *have : keep(reference, load(reference), wraps);
}

std::shared_ptr<const Texture> TextureStore::fromBytes(const std::string& name,
                                                       std::span<const std::uint8_t> bytes,
                                                       TextureWraps wraps) {
    if (const auto have = known(name, wraps))
        return *have;
    return keep(name, decoded(name, decodeTexture(bytes, m_reading.budget)), wraps);
}

std::optional<std::shared_ptr<const Texture>> TextureStore::known(const std::string& name,
                                                                  TextureWraps wraps) const {
    const auto found = m_textures.find({name, wraps});
    return found != m_textures.end() ? std::optional(found->second) : std::nullopt;
}

std::shared_ptr<const Texture>
TextureStore::keep(const std::string& name, std::shared_ptr<Texture> picture, TextureWraps wraps) {
    if (picture) {
        picture->wrap_u = wraps.u;
        picture->wrap_v = wraps.v;
    }
    return m_textures[{name, wraps}] = std::move(picture);
}

std::shared_ptr<const Texture>
TextureStore::combined(const std::shared_ptr<const Texture>& colors,
                       const std::shared_ptr<const Texture>& opacity) {
    if (colors == opacity) // whose alpha counts already; without one it is opaque
        return colors;
    std::shared_ptr<const Texture>& both = m_combined[{colors, opacity}];
    if (!both)
        both = withOpacity(colors.get(), *opacity);
    return both;
}

std::shared_ptr<const Texture>
TextureStore::metalRough(const std::shared_ptr<const Texture>& roughness,
                         const std::shared_ptr<const Texture>& metalness) {
    if (roughness == metalness)
        return roughness;
    const auto [found, is_new] = m_metal_rough.try_emplace({roughness, metalness});
    if (is_new && hasRoomFor(roughness ? *roughness : *metalness))
        found->second = metalRoughPicture(roughness.get(), metalness.get());
    return found->second;
}

std::shared_ptr<const Texture> TextureStore::roughness(const std::shared_ptr<const Texture>& glossy,
                                                       float glossiness) {
    const auto [found, is_new] = m_rough.try_emplace({glossy, glossiness});
    if (is_new && hasRoomFor(*glossy))
        found->second = roughnessOfGlossiness(*glossy, glossiness);
    return found->second;
}

bool TextureStore::hasRoomFor(const Texture& another) {
    const Result<void> taken = m_reading.budget.take(another.rgba.size(), "textures");
    if (!taken)
        warnLeftOut("roughness and metalness", taken.message());
    return taken.ok();
}

std::shared_ptr<Texture> TextureStore::load(const std::string& reference) {
    const std::optional<NamedFile> file = m_reading.folder.find(reference);
    if (file && file->differs_in_case && m_told.insert(reference).second)
        m_warnings.push_back(otherCaseText(reference, *file));
    if (file)
        return decoded(reference, readTextureFile(file->path, m_reading.budget));
    warnLeftOut(reference, m_reading.folder.leadsOutside(reference)
                               ? "it lies outside the model's folder; copy it beside the model"
                               : "there is no such file beside the model");
    return nullptr;
}

std::shared_ptr<Texture> TextureStore::decoded(const std::string& name, Result<Texture> texture) {
    if (texture)
        return std::make_shared<Texture>(std::move(texture.value()));
    warnLeftOut(name, texture.message());
    return nullptr;
}

void TextureStore::warnLeftOut(const std::string& name, const std::string& why) {
    if (m_told.insert(name).second) // other materials may use it otherwise
        m_warnings.push_back("The texture '" + name + "' was left out: " + why + ".");
}

} // namespace quarn
