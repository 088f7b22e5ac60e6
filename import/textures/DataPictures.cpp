#include "import/textures/DataPictures.h"

#include <algorithm>
#include <array>
#include <cstddef>

namespace quarn {

namespace {

constexpr std::size_t GREEN = 1;
constexpr std::size_t BLUE = 2;
constexpr std::size_t ALPHA = 3;

std::uint8_t meanOfColors(const std::uint8_t* rgba) {
    return static_cast<std::uint8_t>((rgba[0] + rgba[1] + rgba[2]) / 3);
}

/// Sets a channel to the means of a picture, each taken at the nearest place.
void setChannel(const Texture& from, std::size_t channel, Texture& to) {
    const auto nearest = [](int at, int size, int other) {
        return static_cast<std::size_t>(static_cast<long long>(at) * other / size);
    };
    std::uint8_t* byte = to.rgba.data() + channel;
    for (int y = 0; y < to.height; ++y) {
        const std::size_t row =
            nearest(y, to.height, from.height) * static_cast<std::size_t>(from.width);
        for (int x = 0; x < to.width; ++x, byte += 4)
            *byte = meanOfColors(from.rgba.data() + 4 * (row + nearest(x, to.width, from.width)));
    }
}

} // namespace

std::shared_ptr<Texture> whiteLike(const Texture& texture) {
    auto white = std::make_shared<Texture>();
    white->width = texture.width;
    white->height = texture.height;
    white->wrap_u = texture.wrap_u;
    white->wrap_v = texture.wrap_v;
    white->rgba.assign(texture.rgba.size(), 255);
    return white;
}

std::shared_ptr<Texture> metalRoughPicture(const Texture* roughness, const Texture* metalness) {
    auto both = whiteLike(roughness != nullptr ? *roughness : *metalness);
    if (roughness != nullptr)
        setChannel(*roughness, GREEN, *both);
    if (metalness != nullptr)
        setChannel(*metalness, BLUE, *both);
    return both;
}

std::shared_ptr<Texture> roughnessOfGlossiness(const Texture& glossy, float glossiness) {
    auto rough = whiteLike(glossy);
    const float factor = std::clamp(glossiness, 0.0F, 1.0F);
    for (std::size_t i = 0; i + ALPHA < glossy.rgba.size(); i += 4)
        rough->rgba[i + GREEN] =
            static_cast<std::uint8_t>(255.5F - factor * static_cast<float>(glossy.rgba[i + ALPHA]));
    return rough;
}

bool holdsNormals(const Texture& picture) {
    constexpr std::size_t LEAST_DIFFERENCE = 30; // flat normals are 128, 128, 255
    std::array<std::size_t, 3> sums{};
    for (std::size_t i = 0; i < picture.rgba.size(); ++i)
        if (i % 4 < sums.size())
            sums[i % 4] += picture.rgba[i];
    const std::size_t margin = LEAST_DIFFERENCE * (picture.rgba.size() / 4);
    return sums[BLUE] > sums[0] + margin && sums[BLUE] > sums[GREEN] + margin;
}

} // namespace quarn
