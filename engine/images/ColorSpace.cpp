#include "engine/images/ColorSpace.h"

#include "engine/scene/SrgbCurve.h"

#include <algorithm>
#include <bit>
#include <cmath>

namespace quarn {

namespace {

constexpr float shoulder_start = 0.6F;
constexpr float shoulder_height = 1.0F - shoulder_start;

std::array<float, 256> makeByteTable() {
    std::array<float, 256> table{};
    for (std::size_t i = 0; i < table.size(); ++i)
        table[i] = linearFromSrgb(static_cast<float>(i) / 255.0F);
    return table;
}

/// The least float from 0 to 1 whose nearest byte is not below `value`. The bits of such floats
/// rise with them.
float leastLinearOf(std::uint8_t value) {
    std::uint32_t low = 0;
    std::uint32_t high = std::bit_cast<std::uint32_t>(1.0F);
    while (low < high) {
        const std::uint32_t middle = low + (high - low) / 2;
        if (srgbByteFromLinear(std::bit_cast<float>(middle)) < value)
            low = middle + 1;
        else
            high = middle;
    }
    return std::bit_cast<float>(low);
}

} // namespace

SrgbTables::SrgbTables() : m_linear(makeByteTable()) {
    for (int value = 0; value < 256; ++value)
        m_least[static_cast<std::size_t>(value)] = leastLinearOf(static_cast<std::uint8_t>(value));
    for (int cell = 0; cell <= cells; ++cell)
        m_first[static_cast<std::size_t>(cell)] =
            srgbByteFromLinear(static_cast<float>(cell) / static_cast<float>(cells));
}

const SrgbTables& srgbTables() {
    static const SrgbTables tables;
    return tables;
}

float linearFromSrgbByte(std::uint8_t value) {
    static const std::array<float, 256> table = makeByteTable();
    return table[value];
}

std::uint8_t srgbByteFromLinear(float linear) {
    const float value = srgbFromLinear(std::clamp(linear, 0.0F, 1.0F));
    return static_cast<std::uint8_t>(std::lround(255.0F * value));
}

float toneMapped(float scene_light) {
    if (scene_light <= shoulder_start)
        return scene_light;
    const float beyond = (scene_light - shoulder_start) / shoulder_height;
    return shoulder_start + shoulder_height * (1.0F - std::exp(-beyond));
}

float sceneLightShownAs(float shown) {
    const float value = std::clamp(shown, 0.0F, 0.9999F);
    if (value <= shoulder_start)
        return value;
    return shoulder_start -
           shoulder_height * std::log(1.0F - (value - shoulder_start) / shoulder_height);
}

LinearColor scaled(const LinearColor& color, float by) {
    return {color.r * by, color.g * by, color.b * by};
}

void setChannels(float (&to)[3], const LinearColor& color) {
    to[0] = color.r;
    to[1] = color.g;
    to[2] = color.b;
}

float brightnessOf(const LinearColor& color) {
    return 0.2126F * color.r + 0.7152F * color.g + 0.0722F * color.b;
}

LinearColor linearFromColor(const KM_Color& color) {
    return {linearFromSrgbByte(color.r), linearFromSrgbByte(color.g), linearFromSrgbByte(color.b)};
}

LinearColor sceneLightShownAs(const KM_Color& color) {
    const LinearColor shown = linearFromColor(color);
    return {sceneLightShownAs(shown.r), sceneLightShownAs(shown.g), sceneLightShownAs(shown.b)};
}

} // namespace quarn
