#include "import/assembly/OlderLooks.h"

#include "engine/scene/SrgbCurve.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace quarn {

float roughnessOfExponent(float exponent) {
    const float width = std::sqrt(2.0F / (std::max(0.0F, exponent) + 2.0F));
    return std::sqrt(width);
}

void setHighlight(Material& material, const LinearRgb& color) {
    constexpr float USUAL = 0.5F; // what an index of refraction of 1.5 mirrors
    const float most = *std::ranges::max_element(color);
    material.specular = std::clamp(most / USUAL, 0.0F, 1.0F);
    if (material.specular > 0.0F)
        for (std::size_t i = 0; i < color.size(); ++i)
            material.specular_color[i] = color[i] / USUAL / material.specular;
}

LinearRgb lightOfColor(const LinearRgb& stated) {
    const float strength =
        std::clamp(*std::ranges::max_element(stated), 1.0F, std::numeric_limits<float>::max());
    LinearRgb light{};
    for (std::size_t i = 0; i < stated.size(); ++i)
        light[i] = strength * linearFromSrgb(stated[i] / strength);
    return light;
}

} // namespace quarn
