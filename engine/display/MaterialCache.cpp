#include "engine/display/MaterialCache.h"

#include <algorithm>

namespace quarn {

namespace {

/// Far beyond what a picture can show, and far from the end of floats.
constexpr float MOST_EMISSION = 1e6F;

bool isWhole(const Texture& texture) {
    return texture.width > 0 && texture.height > 0 &&
           texture.rgba.size() >= 4 * static_cast<std::size_t>(texture.width) *
                                      static_cast<std::size_t>(texture.height);
}

/// What was kept under a key, now or at the revision before.
template <class Map>
typename Map::mapped_type& kept(Map& now, Map& earlier, const typename Map::key_type& key) {
    const auto [place, is_new] = now.try_emplace(key);
    if (const auto found = is_new ? earlier.find(key) : earlier.end(); found != earlier.end())
        place->second = found->second;
    return place->second;
}

} // namespace

void MaterialCache::beginRevision() {
    m_earlier = std::exchange(m_contents, {});
}

void MaterialCache::endRevision() {
    m_earlier = {};
}

const MipTexture* MaterialCache::texture(const std::shared_ptr<const Texture>& texture,
                                         TexelMeaning meaning) {
    CachedTexture& cached = kept(m_contents.textures, m_earlier.textures, {texture.get(), meaning});
    if (!cached.mips)
        cached = {texture, std::make_shared<const MipTexture>(*texture, meaning)};
    return cached.mips.get();
}

const SurfaceLook* MaterialCache::look(const std::shared_ptr<const Material>& material,
                                       bool has_coordinates) {
    if (!material)
        return nullptr;
    CachedLook& cached = kept(m_contents.looks, m_earlier.looks, {material.get(), has_coordinates});
    if (!cached.source) {
        const SurfaceLook look = makeLook(*material, has_coordinates);
        cached.source = material;
        if (look != SurfaceLook())
            cached.look = std::make_shared<const SurfaceLook>(look);
    }
    return cached.look.get();
}

/// A texture without all its bytes counts as none.
LookTexture MaterialCache::use(const TextureUse& use, TexelMeaning meaning) {
    LookTexture result;
    if (!use.texture || !isWhole(*use.texture))
        return result;
    result.mips = texture(use.texture, meaning);
    std::ranges::copy(use.u, result.u);
    std::ranges::copy(use.v, result.v);
    return result;
}

/// Called for what is metal or glossy: anything else stays matt.
void MaterialCache::addMirrors(const Material& material, SurfaceLook& look) {
    LookNumbers<float>& numbers = look.numbers;
    look.mirrors = true;
    numbers.metalness = material.metalness;
    numbers.roughness = material.roughness;
    const float index = material.index_of_refraction;
    const float root = (index - 1.0F) / (index + 1.0F); // A. Fresnel's equations, straight on
    numbers.f90 = material.specular;
    for (std::size_t c = 0; c < 3; ++c)
        numbers.f0[c] =
            material.specular * std::min(1.0F, root * root * material.specular_color[c]);
}

SurfaceLook MaterialCache::makeLook(const Material& material, bool has_coordinates) {
    SurfaceLook look;
    look.is_unlit = material.is_unlit;
    if (look.is_unlit)
        return look;
    for (std::size_t c = 0; c < 3; ++c)
        look.numbers.emission[c] = std::min(material.emission[c], MOST_EMISSION);
    const bool has_metal_rough = has_coordinates && material.metal_rough.texture;
    if (material.metalness > 0.0F || material.roughness < 1.0F || has_metal_rough)
        addMirrors(material, look);
    if (has_coordinates)
        addTextures(material, look);
    return look;
}

void MaterialCache::addTextures(const Material& material, SurfaceLook& look) {
    if (std::ranges::any_of(look.numbers.emission, [](float number) { return number > 0.0F; }))
        look.emission = use(material.emission_texture, TexelMeaning::colors);
    if (material.normal_scale != 0.0F)
        look.normals = use(material.normals, TexelMeaning::numbers);
    if (look.normals.mips)
        look.normal_scale = material.normal_scale;
    if (material.occlusion_strength > 0.0F)
        look.occlusion = use(material.occlusion, TexelMeaning::numbers);
    if (look.occlusion.mips)
        look.occlusion_strength = material.occlusion_strength;
    if (look.mirrors)
        look.metal_rough = use(material.metal_rough, TexelMeaning::numbers);
    for (const LookTexture* texture :
         {&look.emission, &look.normals, &look.occlusion, &look.metal_rough})
        look.has_textures |= texture->mips != nullptr;
}

} // namespace quarn
