#include "host/display/ColorSpace.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace quarn {

namespace {

constexpr float shoulder_start = 0.6F;
constexpr float shoulder_height = 1.0F - shoulder_start;

float linearFromSrgb(float value) {
    return value <= 0.04045F ? value / 12.92F : std::pow((value + 0.055F) / 1.055F, 2.4F);
}

float srgbFromUnit(float linear) {
    return linear <= 0.0031308F ? 12.92F * linear : 1.055F * std::pow(linear, 1.0F / 2.4F) - 0.055F;
}

std::array<float, 256> makeByteTable() {
    std::array<float, 256> table{};
    for (std::size_t i = 0; i < table.size(); ++i)
        table[i] = linearFromSrgb(static_cast<float>(i) / 255.0F);
    return table;
}

} // namespace

float linearFromSrgbByte(std::uint8_t value) {
    static const std::array<float, 256> table = makeByteTable();
    return table[value];
}

std::uint8_t srgbByteFromLinear(float linear) {
    const float value = srgbFromUnit(std::clamp(linear, 0.0F, 1.0F));
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

LinearColor linearFromColor(const KM_Color& color) {
    return {linearFromSrgbByte(color.r), linearFromSrgbByte(color.g), linearFromSrgbByte(color.b)};
}

LinearColor sceneLightShownAs(const KM_Color& color) {
    const LinearColor shown = linearFromColor(color);
    return {sceneLightShownAs(shown.r), sceneLightShownAs(shown.g), sceneLightShownAs(shown.b)};
}

} // namespace quarn
