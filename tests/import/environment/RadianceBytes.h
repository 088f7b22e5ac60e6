#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

namespace quarn::test {

/// A pixel of a Radiance picture: mantissas of red, green and blue, and their exponent. A channel
/// is its mantissa times 2 to the power of (exponent - 136).
using Rgbe = std::array<std::uint8_t, 4>;

/// A value of 1 for each of 128 in a mantissa.
inline constexpr std::uint8_t ONE = 129;

inline std::string radianceHead(int width, int height) {
    return "#?RADIANCE\nFORMAT=32-bit_rle_rgbe\n\n-Y " + std::to_string(height) + " +X " +
           std::to_string(width) + "\n";
}

/// A picture whose rows are not compressed, which the format has for less than 8 columns.
inline std::string flatRadiance(int width, int height, const std::vector<Rgbe>& pixels) {
    std::string bytes = radianceHead(width, height);
    for (const Rgbe& pixel : pixels)
        bytes.append(pixel.begin(), pixel.end());
    return bytes;
}

/// One of 8 columns or more, of one colour, in runs.
inline std::string plainRadiance(int width, int height, const Rgbe& color) {
    std::string bytes = radianceHead(width, height);
    for (int row = 0; row < height; ++row) {
        bytes += {'\2', '\2', static_cast<char>(width >> 8), static_cast<char>(width)};
        for (const std::uint8_t channel : color)
            for (int left = width; left > 0; left -= 127)
                bytes += {static_cast<char>(128 + (left < 127 ? left : 127)),
                          static_cast<char>(channel)};
    }
    return bytes;
}

} // namespace quarn::test
