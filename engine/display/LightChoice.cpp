#include "engine/display/LightChoice.h"

#include <algorithm>

namespace quarn {

namespace {

bool isSun(const KM_Light& light) {
    return light.IsEnabled() && light.Style() == KM_LightStyle::world_directional;
}

double longestSide(const KM_BoundingBox& box) {
    const KM_3dVector sides = box.Diagonal();
    return std::max({sides.x, sides.y, sides.z});
}

} // namespace

Surroundings surroundingsOf(const LightSettings& settings, std::span<const KM_Light> lights,
                            const KM_BoundingBox& box) {
    const bool has_picture = settings.picture && isPicture(*settings.picture);
    const bool is_open = settings.surroundings == Surroundings::automatic ||
                         (settings.surroundings == Surroundings::picture && !has_picture);
    if (!is_open)
        return settings.surroundings;
    if (!box.IsValid() || std::ranges::any_of(lights, isSun))
        return Surroundings::sky;
    return longestSide(box) * settings.metres_per_unit > LARGEST_PRODUCT_M ? Surroundings::sky
                                                                           : Surroundings::studio;
}

bool isPicture(const EnvironmentPicture& picture) {
    return picture.width > 0 && picture.height > 0 &&
           picture.rgb.size() == std::size_t{3} * static_cast<std::size_t>(picture.width) *
                                     static_cast<std::size_t>(picture.height);
}

} // namespace quarn
