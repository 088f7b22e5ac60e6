#include "engine/display/MipTexture.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

int mirrored(int index, int count) {
    const int period = 2 * count;
    const int place = ((index % period) + period) % period;
    return place < count ? place : period - 1 - place;
}

int wrapped(int index, int count, TextureWrap wrap) {
    if (wrap == TextureWrap::clamp)
        return std::clamp(index, 0, count - 1);
    if (wrap == TextureWrap::mirror)
        return mirrored(index, count);
    return ((index % count) + count) % count;
}

/// Keeps whole repetitions out of the arithmetic, so that far coordinates lose no precision.
float reduced(float coordinate, TextureWrap wrap) {
    if (!std::isfinite(coordinate))
        return 0.0F;
    if (wrap == TextureWrap::clamp)
        return std::clamp(coordinate, -1.0F, 2.0F);
    return coordinate - 2.0F * std::floor(0.5F * coordinate);
}

TextureSample mixed(const TextureSample& a, const TextureSample& b, float t) {
    const auto mix = [t](float x, float y) { return x + t * (y - x); };
    return {{mix(a.color.r, b.color.r), mix(a.color.g, b.color.g), mix(a.color.b, b.color.b)},
            mix(a.alpha, b.alpha)};
}

std::uint8_t byteOf(float number) {
    return static_cast<std::uint8_t>(std::lround(255.0F * number));
}

std::size_t texelOffset(int x, int y, int width) {
    return 4 * (static_cast<std::size_t>(y) * static_cast<std::size_t>(width) +
                static_cast<std::size_t>(x));
}

} // namespace

MipTexture::MipTexture(const Texture& texture, TexelMeaning meaning)
    : m_wrap_u(texture.wrap_u), m_wrap_v(texture.wrap_v), m_meaning(meaning) {
    const bool whole = texture.width > 0 && texture.height > 0 &&
                       texture.rgba.size() >= texelOffset(0, texture.height, texture.width);
    if (whole)
        m_levels.push_back({texture.width, texture.height, texture.rgba});
    else
        m_levels.push_back({1, 1, {255, 255, 255, 255}});
    while (m_levels.back().width > 1 || m_levels.back().height > 1)
        m_levels.push_back(halved(m_levels.back()));
}

TextureSample MipTexture::texel(const std::uint8_t* rgba) const {
    const auto number = [&](int channel) { return static_cast<float>(rgba[channel]) / 255.0F; };
    if (m_meaning == TexelMeaning::numbers)
        return {{number(0), number(1), number(2)}, number(3)};
    return {{linearFromSrgbByte(rgba[0]), linearFromSrgbByte(rgba[1]), linearFromSrgbByte(rgba[2])},
            number(3)};
}

MipTexture::Level MipTexture::halved(const Level& larger) const {
    const auto stored = m_meaning == TexelMeaning::numbers ? byteOf : srgbByteFromLinear;
    Level level{std::max(larger.width / 2, 1), std::max(larger.height / 2, 1), {}};
    level.rgba.resize(texelOffset(0, level.height, level.width));
    for (int y = 0; y < level.height; ++y) {
        const int y0 = std::min(2 * y, larger.height - 1);
        const int y1 = std::min(2 * y + 1, larger.height - 1);
        for (int x = 0; x < level.width; ++x) {
            const int x0 = std::min(2 * x, larger.width - 1);
            const int x1 = std::min(2 * x + 1, larger.width - 1);
            const auto at = [&](int i, int j) {
                return texel(&larger.rgba[texelOffset(i, j, larger.width)]);
            };
            const TextureSample mean = mixed(mixed(at(x0, y0), at(x1, y0), 0.5F),
                                             mixed(at(x0, y1), at(x1, y1), 0.5F), 0.5F);
            std::uint8_t* to = &level.rgba[texelOffset(x, y, level.width)];
            to[0] = stored(mean.color.r);
            to[1] = stored(mean.color.g);
            to[2] = stored(mean.color.b);
            to[3] = byteOf(mean.alpha);
        }
    }
    return level;
}

TextureSample MipTexture::sampleLevel(const Level& level, float u, float v) const {
    const float x = u * static_cast<float>(level.width) - 0.5F;
    const float y = (1.0F - v) * static_cast<float>(level.height) - 0.5F;
    const float left = std::floor(x);
    const float upper = std::floor(y);
    const auto at = [&](int i, int j) {
        const int column = wrapped(static_cast<int>(left) + i, level.width, m_wrap_u);
        const int row = wrapped(static_cast<int>(upper) + j, level.height, m_wrap_v);
        return texel(&level.rgba[texelOffset(column, row, level.width)]);
    };
    return mixed(mixed(at(0, 0), at(1, 0), x - left), mixed(at(0, 1), at(1, 1), x - left),
                 y - upper);
}

TextureSample MipTexture::sample(float u, float v, float level) const {
    const float s = reduced(u, m_wrap_u);
    const float t = reduced(v, m_wrap_v);
    const float last = static_cast<float>(m_levels.size() - 1);
    const float place = level > 0.0F ? std::min(level, last) : 0.0F;
    const auto sharper = static_cast<std::size_t>(place);
    const float toward_softer = place - static_cast<float>(sharper);
    const TextureSample sharp = sampleLevel(m_levels[sharper], s, t);
    if (toward_softer < 0.02F || sharper + 1 >= m_levels.size())
        return sharp;
    return mixed(sharp, sampleLevel(m_levels[sharper + 1], s, t), toward_softer);
}

} // namespace quarn
