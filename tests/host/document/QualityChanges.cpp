#include "tests/host/document/QualityChanges.h"

namespace quarn::test {

namespace {

template <class T> bool isSame(const T& a, const T& b) {
    return a == b;
}

bool isSame(const TextureUse& a, const TextureUse& b) {
    return a.u == b.u && a.v == b.v && a.texture && b.texture && a.texture->rgba == b.texture->rgba;
}

class Changes {
public:
    template <class T> Changes& set(const char* name, T Material::*quality, const T& value) {
        m_changes.push_back(
            {name, [=](Material& material) { material.*quality = value; },
             [=](const Material& material) { return isSame(material.*quality, value); }});
        return *this;
    }
    Changes& texture(const char* name, TextureUse Material::*quality) {
        const auto number = static_cast<std::uint8_t>(m_changes.size());
        const auto shift = static_cast<float>(number);
        return set(name, quality,
                   TextureUse{pairOfPixels(number), {2.0F, 0.5F, shift}, {-0.25F, 1.5F, -shift}});
    }
    std::vector<QualityChange> all() { return std::move(m_changes); }

private:
    std::vector<QualityChange> m_changes;
};

} // namespace

std::shared_ptr<const Texture> pairOfPixels(std::uint8_t first) {
    auto texture = std::make_shared<Texture>();
    texture->width = 2;
    texture->height = 1;
    texture->rgba = {first, 10, 20, 255, 30, 40, 50, 128};
    return texture;
}

std::vector<QualityChange> qualityChanges() {
    using M = Material;
    return Changes()
        .set("metalness", &M::metalness, 0.9F)
        .set("roughness", &M::roughness, 0.3F)
        .texture("metal_rough", &M::metal_rough)
        .texture("normals", &M::normals)
        .set("normal_scale", &M::normal_scale, -0.75F)
        .texture("occlusion", &M::occlusion)
        .set("occlusion_strength", &M::occlusion_strength, 0.4F)
        .set("emission", &M::emission, {1.0F, 20.0F, 0.5F})
        .texture("emission_texture", &M::emission_texture)
        .set("one_sided", &M::is_one_sided, true)
        .set("unlit", &M::is_unlit, true)
        .set("clearcoat", &M::clearcoat, 0.8F)
        .set("clearcoat_roughness", &M::clearcoat_roughness, 0.05F)
        .texture("clearcoat_texture", &M::clearcoat_texture)
        .texture("clearcoat_roughness_texture", &M::clearcoat_roughness_texture)
        .texture("clearcoat_normals", &M::clearcoat_normals)
        .set("transmission", &M::transmission, 0.95F)
        .texture("transmission_texture", &M::transmission_texture)
        .set("index_of_refraction", &M::index_of_refraction, 1.33F)
        .set("thickness", &M::thickness, 0.02F)
        .texture("thickness_texture", &M::thickness_texture)
        .set("attenuation_distance", &M::attenuation_distance, 0.7F)
        .set("attenuation_color", &M::attenuation_color, {0.1F, 0.2F, 0.9F})
        .set("specular", &M::specular, 0.6F)
        .set("specular_color", &M::specular_color, {0.7F, 1.5F, 0.0F})
        .texture("specular_texture", &M::specular_texture)
        .texture("specular_color_texture", &M::specular_color_texture)
        .set("sheen_color", &M::sheen_color, {0.25F, 0.0F, 0.125F})
        .set("sheen_roughness", &M::sheen_roughness, 0.55F)
        .all();
}

Material changedMaterial() {
    Material material;
    material.name = L"Lack";
    for (const QualityChange& change : qualityChanges())
        change.make(material);
    return material;
}

} // namespace quarn::test
