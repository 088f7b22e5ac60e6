#pragma once

#include "kelmar/KM_Color.h"

#include <cstdint>

namespace quarn {

/// Linear light of an sRGB byte, 0 to 1 (IEC 61966-2-1).
float linearFromSrgbByte(std::uint8_t value);

/// The sRGB byte nearest to a linear value; values outside 0 to 1 are moved to the limit.
std::uint8_t srgbByteFromLinear(float linear);

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

/// Linear light of an sRGB colour.
LinearColor linearFromColor(const KM_Color& color);
/// The scene light that is shown as this colour.
LinearColor sceneLightShownAs(const KM_Color& color);

} // namespace quarn
