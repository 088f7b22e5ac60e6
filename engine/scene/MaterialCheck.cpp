#include "engine/scene/MaterialCheck.h"

#include "engine/scene/MaterialTextures.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <utility>

namespace quarn {

namespace {

constexpr float MOST_NORMAL_SCALE = 1000.0F;
constexpr float MOST_SPECULAR_COLOR = 1000.0F;
constexpr float LARGEST_LENGTH = 1e30F;
constexpr float SMALLEST_LENGTH = 1e-30F;
/// Beyond it single precision knows no place within a texture.
constexpr float MOST_PLACE = 1e6F;

/// In the order of textureUses.
constexpr std::array<const char*, 11> TEXTURE_NAMES{"texture of metalness and roughness",
                                                    "normal map",
                                                    "occlusion texture",
                                                    "emission texture",
                                                    "clearcoat texture",
                                                    "clearcoat roughness texture",
                                                    "clearcoat normal map",
                                                    "transmission texture",
                                                    "thickness texture",
                                                    "specular texture",
                                                    "specular colour texture"};

struct Limits {
    float low;
    float high;
};

constexpr Limits SHARE{0.0F, 1.0F};

bool isWhole(const Texture& texture) {
    return texture.width > 0 && texture.height > 0 &&
           texture.rgba.size() == 4 * static_cast<std::size_t>(texture.width) *
                                      static_cast<std::size_t>(texture.height);
}

class Repair {
public:
    explicit Repair(Material& material) : m_material(material) {}

    std::string make() {
        repairSurface();
        repairGlass();
        repairRest();
        repairTextures();
        return std::move(m_changed);
    }

private:
    void repairSurface() {
        limit(m_material.alpha_cutoff, SHARE, m_usual.alpha_cutoff, "alpha cutoff");
        limit(m_material.metalness, SHARE, m_usual.metalness, "metalness");
        limit(m_material.roughness, SHARE, m_usual.roughness, "roughness");
        limit(m_material.normal_scale, {-MOST_NORMAL_SCALE, MOST_NORMAL_SCALE},
              m_usual.normal_scale, "normal scale");
        limit(m_material.occlusion_strength, SHARE, m_usual.occlusion_strength,
              "occlusion strength");
        repairEmission();
    }

    /// What is too bright keeps its hue.
    void repairEmission() {
        LinearRgb& light = m_material.emission;
        const LinearRgb given = light;
        for (float& channel : light)
            channel = std::isnan(channel)
                          ? 0.0F
                          : std::clamp(channel, 0.0F, std::numeric_limits<float>::max());
        const float most = *std::ranges::max_element(light);
        if (most > MOST_EMISSION)
            for (float& channel : light)
                channel = std::min(channel / most * MOST_EMISSION, MOST_EMISSION);
        note(light != given, "emission");
    }

    void repairGlass() {
        limit(m_material.transmission, SHARE, m_usual.transmission, "transmission");
        if (m_material.index_of_refraction < 1.0F) {
            m_material.index_of_refraction = m_usual.index_of_refraction;
            note(true, "index of refraction");
        }
        limit(m_material.index_of_refraction, {1.0F, MOST_INDEX_OF_REFRACTION},
              m_usual.index_of_refraction, "index of refraction");
        limit(m_material.thickness, {0.0F, LARGEST_LENGTH}, m_usual.thickness, "thickness");
        limit(m_material.attenuation_color, SHARE, 1.0F, "attenuation colour");
        float& distance = m_material.attenuation_distance;
        const bool is_distance = distance > 0.0F;
        if (!is_distance)
            distance = m_usual.attenuation_distance;
        const bool is_tiny = distance < SMALLEST_LENGTH;
        if (is_tiny)
            distance = SMALLEST_LENGTH;
        note(!is_distance || is_tiny, "attenuation distance");
    }

    void repairRest() {
        limit(m_material.clearcoat, SHARE, m_usual.clearcoat, "clearcoat");
        limit(m_material.clearcoat_roughness, SHARE, m_usual.clearcoat_roughness,
              "clearcoat roughness");
        limit(m_material.specular, SHARE, m_usual.specular, "specular");
        limit(m_material.specular_color, {0.0F, MOST_SPECULAR_COLOR}, 1.0F, "specular colour");
        limit(m_material.sheen_color, SHARE, 0.0F, "sheen colour");
        limit(m_material.sheen_roughness, SHARE, m_usual.sheen_roughness, "sheen roughness");
    }

    void repairTextures() {
        if (m_material.base_color_texture && !isWhole(*m_material.base_color_texture)) {
            m_material.base_color_texture.reset();
            note(true, "texture of the base colour");
        }
        const auto uses = textureUses(m_material);
        static_assert(std::tuple_size_v<decltype(textureUses(m_material))> == TEXTURE_NAMES.size());
        for (std::size_t i = 0; i < uses.size(); ++i)
            repairTexture(*uses[i], TEXTURE_NAMES[i]);
    }

    void repairTexture(TextureUse& use, const char* name) {
        const bool is_whole = !use.texture || isWhole(*use.texture);
        const auto is_place = [](float number) { return std::abs(number) <= MOST_PLACE; };
        const bool has_place =
            std::ranges::all_of(use.u, is_place) && std::ranges::all_of(use.v, is_place);
        if (!is_whole)
            use = {};
        else if (!has_place)
            use = {use.texture, TextureUse().u, TextureUse().v};
        note(!is_whole || !has_place, name);
    }

    void limit(float& number, const Limits& limits, float usual, const char* name) {
        const float wanted =
            std::isnan(number) ? usual : std::clamp(number, limits.low, limits.high);
        const bool is_other = wanted != number;
        number = wanted;
        note(is_other, name);
    }

    void limit(LinearRgb& color, const Limits& limits, float usual, const char* name) {
        const LinearRgb given = color;
        for (float& channel : color)
            channel = std::isnan(channel) ? usual : std::clamp(channel, limits.low, limits.high);
        note(color != given, name);
    }

    void note(bool is_changed, const char* name) {
        if (is_changed)
            m_changed += (m_changed.empty() ? "" : ", ") + std::string(name);
    }

    Material& m_material;
    const Material m_usual{};
    std::string m_changed;
};

} // namespace

std::string makeDrawable(Material& material) {
    return Repair(material).make();
}

} // namespace quarn
