#include "import/obj/ObjLook.h"

#include "import/assembly/OlderLooks.h"
#include "import/assembly/StoredColor.h"
#include "import/textures/DataPictures.h"
#include "import/textures/TextureTransparency.h"

#include <utility>

namespace quarn {

namespace {

constexpr LinearRgb BLACK{0.0F, 0.0F, 0.0F};
constexpr LinearRgb WHITE{1.0F, 1.0F, 1.0F};

/// Many programs write an opacity of 0 where they mean that there is none to write.
void setTransparency(const FileMaterial& source, Material& material) {
    const bool is_dimmed = material.base_color.a < 255 && material.base_color.a > 0;
    const bool texture_counts =
        !source.opacity_map.file.empty() && material.base_color_texture != nullptr;
    const Transparency of_texture =
        texture_counts ? transparencyOf(*material.base_color_texture) : Transparency::none;
    material.see_through = is_dimmed || of_texture == Transparency::partial;
    material.alpha_cutout = !material.see_through && of_texture == Transparency::holes;
}

KM_Color colorOf(const FileMaterial& source, const Material& material) {
    const float opacity = source.opacity.value_or(1.0F - source.transparency.value_or(0.0F));
    const bool is_textured = material.base_color_texture != nullptr;
    KM_Color color = material.base_color;
    if (source.color)
        color = colorFromSrgb((*source.color)[0], (*source.color)[1], (*source.color)[2], 1.0F);
    // Many programs write black, or nothing, where the texture alone gives the colour.
    const bool is_black = color.r == 0 && color.g == 0 && color.b == 0;
    if (is_textured && (is_black || !source.color))
        color = {255, 255, 255, 255};
    color.a = byteFromUnit(opacity);
    return color;
}

/// As with the base colour, a picture stands for itself where nothing or black is stated beside it.
LinearRgb besidePicture(const std::optional<LinearRgb>& stated, const TextureUse& picture) {
    const LinearRgb color = stated.value_or(BLACK);
    return picture.texture != nullptr && color == BLACK ? WHITE : color;
}

class Look {
public:
    Look(const FileMaterial& source, TextureStore& textures)
        : m_source(source), m_textures(textures) {}

    ObjMaterial make() {
        m_material.name = KM_wString::FromUtf8(m_source.name);
        makeBaseColor();
        setTransparency(m_source, m_material);
        makeRoughness();
        makeHighlight();
        makeLight();
        makeRelief();
        m_material.clearcoat = m_source.clearcoat.value_or(m_material.clearcoat);
        m_material.clearcoat_roughness =
            m_source.clearcoat_roughness.value_or(m_material.clearcoat_roughness);
        return {std::make_shared<const Material>(std::move(m_material)), m_place};
    }

private:
    /// The opacity may have a picture of its own.
    void makeBaseColor() {
        const MaterialMap& colors = m_source.color_map;
        const MaterialMap& opacity = m_source.opacity_map;
        std::shared_ptr<const Texture>& texture = m_material.base_color_texture;
        if (!colors.file.empty())
            texture = m_textures.fromFile(colors.file, colors.wraps);
        m_place = texture ? colors.place : opacity.place;
        if (!opacity.file.empty())
            if (const auto picture = m_textures.fromFile(opacity.file, opacity.wraps))
                texture = m_textures.combined(texture, picture);
        m_material.base_color = colorOf(m_source, m_material);
    }

    /// A picture stands in place of the number.
    void makeRoughness() {
        if (m_source.exponent)
            m_material.roughness = roughnessOfExponent(*m_source.exponent);
        m_material.roughness = m_source.roughness.value_or(m_material.roughness);
        m_material.metalness = m_source.metalness.value_or(m_material.metalness);
        const TextureUse rough = used(m_source.roughness_map);
        const TextureUse metal = used(m_source.metalness_map);
        m_material.metal_rough = rough.texture ? rough : metal;
        m_material.metal_rough.texture = m_textures.metalRough(rough.texture, metal.texture);
        if (rough.texture)
            m_material.roughness = 1.0F;
        if (metal.texture)
            m_material.metalness = 1.0F;
    }

    /// Materials with numbers of roughness or metalness mirror as those of their kind do.
    void makeHighlight() {
        if (m_source.roughness || m_source.metalness || m_material.metal_rough.texture)
            return;
        m_material.specular_color_texture = used(m_source.specular_map);
        if (m_source.specular || m_material.specular_color_texture.texture)
            setHighlight(m_material,
                         besidePicture(m_source.specular, m_material.specular_color_texture));
    }

    void makeLight() {
        m_material.emission_texture = used(m_source.emission_map);
        m_material.emission =
            lightOfColor(besidePicture(m_source.emission, m_material.emission_texture));
    }

    void makeRelief() {
        const bool has_normals = !m_source.normal_map.file.empty();
        const MaterialMap& map = has_normals ? m_source.normal_map : m_source.bump_map;
        TextureUse use = used(map);
        if (use.texture == nullptr)
            return;
        if (!has_normals && !holdsNormals(*use.texture)) {
            m_textures.warnLeftOut(map.file, HEIGHTS_NOT_DRAWN);
            return;
        }
        m_material.normals = std::move(use);
        m_material.normal_scale = map.strength;
    }

    TextureUse used(const MaterialMap& map) {
        TextureUse use;
        if (map.file.empty())
            return use;
        if (layTexture(m_place, map.place, use))
            use.texture = m_textures.fromFile(map.file, map.wraps);
        else
            m_textures.warnLeftOut(map.file, "the picture of the colour beside it has no extent");
        return use;
    }

    const FileMaterial& m_source;
    TextureStore& m_textures;
    Material m_material;
    TexturePlace m_place;
};

} // namespace

ObjMaterial lookOf(const FileMaterial& source, TextureStore& textures) {
    return Look(source, textures).make();
}

} // namespace quarn
