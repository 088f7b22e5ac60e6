#include "host/sunhours/TextPainter.h"

#include <cmath>

namespace quarn {

namespace {

/// The em square of the program's font, of what its letters reach from the lowest to the highest.
constexpr double EM_OF_HEIGHT = 2048.0 / 2384.0;

} // namespace

double TextPainter::width(std::string_view utf8, double size_px) const {
    return m_letters.width(utf8, EM_OF_HEIGHT * size_px);
}

void TextPainter::draw(Image& image, double x, double y, std::string_view utf8, double size_px,
                       KM_Color color) const {
    m_letters.shade(utf8, EM_OF_HEIGHT * size_px, x, y, [&](int column, int row, double share) {
        cover(image, column, row, color, share);
    });
}

void cover(Image& image, int x, int y, KM_Color color, double share) {
    if (x < 0 || y < 0 || x >= image.width || y >= image.height)
        return;
    std::uint8_t* const pixel =
        &image.rgba[4 * (static_cast<std::size_t>(y) * static_cast<std::size_t>(image.width) +
                         static_cast<std::size_t>(x))];
    const std::uint8_t over[3] = {color.r, color.g, color.b};
    for (int c = 0; c < 3; ++c)
        pixel[c] = static_cast<std::uint8_t>(std::lround(pixel[c] + share * (over[c] - pixel[c])));
}

} // namespace quarn
