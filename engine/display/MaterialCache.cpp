#include "engine/display/MaterialCache.h"

#include "engine/scene/MaterialCheck.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// A colour that lets less through looks black as well.
constexpr float LEAST_ATTENUATION = 1e-6F;
/// Nothing is seen behind any way that a float can tell.
constexpr float MOST_ABSORPTION = 1e30F;
/// Of the distance after which light has its colour: through more of it next to nothing comes.
constexpr float LONGEST_PATH = 1e6F;

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

/// Anything that is neither metal nor glossy, glass or coated stays matt.
bool mirrorsAnything(const Material& material, bool has_coordinates) {
    return material.metalness > 0.0F || material.roughness < 1.0F || material.clearcoat > 0.0F ||
           material.transmission > 0.0F || (has_coordinates && material.metal_rough.texture);
}

/// Surfaces that mirror next to nothing straight on mirror little along their faces too, so that
/// what has the index of air is not seen (S. Lagarde and C. de Rousiers, "Moving Frostbite to
/// Physically Based Rendering", SIGGRAPH 2014 course).
constexpr float LEAST_F0_OF_FULL_F90 = 0.02F;

void setMirrors(const Material& material, SurfaceLook& look) {
    LookNumbers<float>& numbers = look.numbers;
    look.mirrors = true;
    numbers.metalness = material.metalness;
    numbers.roughness = material.roughness;
    const float index = material.index_of_refraction;
    const float root = (index - 1.0F) / (index + 1.0F); // A. Fresnel's equations, straight on
    const float f0 = root * root;
    numbers.f90 = material.specular * std::min(1.0F, f0 / LEAST_F0_OF_FULL_F90);
    for (std::size_t c = 0; c < 3; ++c)
        numbers.f0[c] = material.specular * std::min(1.0F, f0 * material.specular_color[c]);
    numbers.clearcoat = material.clearcoat;
    numbers.clearcoat_roughness = material.clearcoat_roughness;
}

/// A body of glass has two surfaces: each takes half of what the inside does, as A. Beer's law
/// says. The thickness is that of the material, or of its texture, however the body stands. The
/// less it bends light the less its roughness blurs what is behind: by that of air not at all.
void setGlass(const Material& material, SurfaceLook& look) {
    look.numbers.transmission = material.transmission;
    const float path =
        std::min(0.5F * material.thickness / material.attenuation_distance, LONGEST_PATH);
    look.index = material.index_of_refraction;
    look.is_thin = material.thickness <= 0.0F;
    for (std::size_t c = 0; c < 3; ++c) {
        const float color = std::clamp(material.attenuation_color[c], LEAST_ATTENUATION, 1.0F);
        if (!look.is_thin)
            look.absorption[c] =
                std::min(-std::log(color) / material.attenuation_distance, MOST_ABSORPTION);
        look.density[c] = -path * std::log(color);
        look.numbers.passing[c] = material.transmission;
    }
    look.numbers.bend = std::clamp(2.0F * (material.index_of_refraction - 1.0F), 0.0F, 1.0F);
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

SurfaceLook MaterialCache::makeLook(const Material& material, bool has_coordinates) {
    SurfaceLook look;
    look.is_unlit = material.is_unlit;
    if (look.is_unlit)
        return look;
    for (std::size_t c = 0; c < 3; ++c)
        look.numbers.emission[c] = std::min(material.emission[c], MOST_EMISSION);
    if (mirrorsAnything(material, has_coordinates))
        setMirrors(material, look);
    if (material.transmission > 0.0F)
        setGlass(material, look);
    look.shows_scene = look.mirrors && look.numbers.metalness > 0.5F &&
                       look.numbers.roughness < roughness_of_surroundings;
    if (has_coordinates)
        addTextures(material, look);
    if (!look.thickness.mips)
        for (std::size_t c = 0; c < 3; ++c) {
            look.numbers.passing[c] *= std::exp(-look.density[c]);
            look.density[c] = 0.0F;
        }
    return look;
}

void MaterialCache::addTextures(const Material& material, SurfaceLook& look) {
    const auto add = [&](bool counts, const TextureUse& from, LookTexture& to,
                         TexelMeaning meaning = TexelMeaning::numbers) {
        if (counts)
            to = use(from, meaning);
        look.has_textures |= to.mips != nullptr;
    };
    const auto& numbers = look.numbers;
    const bool glows = std::ranges::any_of(numbers.emission, [](float e) { return e > 0.0F; });
    add(glows, material.emission_texture, look.emission, TexelMeaning::colors);
    add(material.normal_scale != 0.0F, material.normals, look.normals);
    look.normal_scale = look.normals.mips ? material.normal_scale : 1.0F;
    add(material.occlusion_strength > 0.0F, material.occlusion, look.occlusion);
    look.occlusion_strength = look.occlusion.mips ? material.occlusion_strength : 1.0F;
    add(look.mirrors, material.metal_rough, look.metal_rough);
    add(look.mirrors, material.specular_texture, look.specular);
    add(look.mirrors, material.specular_color_texture, look.specular_color, TexelMeaning::colors);
    add(numbers.transmission > 0.0F, material.transmission_texture, look.transmission);
    add(look.density[0] + look.density[1] + look.density[2] > 0.0F, material.thickness_texture,
        look.thickness);
    const bool has_coat = numbers.clearcoat > 0.0F;
    add(has_coat, material.clearcoat_texture, look.clearcoat);
    add(has_coat, material.clearcoat_roughness_texture, look.clearcoat_roughness);
    add(has_coat, material.clearcoat_normals, look.coat_normals);
}

} // namespace quarn
