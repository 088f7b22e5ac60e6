#pragma once

#include "kelmar/KM_Color.h"

#include <array>
#include <cstdint>

namespace quarn {

/// Linear light of an sRGB byte, 0 to 1 (IEC 61966-2-1).
float linearFromSrgbByte(std::uint8_t value);

/// The sRGB byte nearest to a linear value; values outside 0 to 1 are moved to the limit.
std::uint8_t srgbByteFromLinear(float linear);

/// linearFromSrgbByte and srgbByteFromLinear by tables, for many colours.
class SrgbTables {
public:
    SrgbTables();
    float linear(std::uint8_t value) const { return m_linear[value]; }
    /// @param linear  0 to 1
    std::uint8_t byte(float linear) const {
        unsigned value = m_first[static_cast<std::size_t>(linear * cells)];
        while (value < 255 && linear >= m_least[value + 1])
            ++value;
        return static_cast<std::uint8_t>(value);
    }

private:
    static constexpr int cells = 1024;
    std::array<float, 256> m_linear;
    std::array<float, 256> m_least;              ///< of each byte the least linear value
    std::array<std::uint8_t, cells + 1> m_first; ///< the byte at the beginning of each cell
};

/// The tables, made once.
const SrgbTables& srgbTables();

/// Scene light as it is shown: the same up to 0.6, above it ever less until 1 is reached far out,
/// so that bright surfaces keep their modelling.
float toneMapped(float scene_light);

/// The scene light that toneMapped takes to `shown`, which is moved into 0 to 0.9999 before.
float sceneLightShownAs(float shown);

/// A linear colour.
struct LinearColor {
    float r = 0.0F;
    float g = 0.0F;
    float b = 0.0F;
};

LinearColor scaled(const LinearColor& color, float by);
void setChannels(float (&to)[3], const LinearColor& color);

/// The luminance of linear light by ITU-R BT.709.
float brightnessOf(const LinearColor& color);

/// Linear light of an sRGB colour.
LinearColor linearFromColor(const KM_Color& color);
/// The scene light that is shown as this colour.
LinearColor sceneLightShownAs(const KM_Color& color);

} // namespace quarn
