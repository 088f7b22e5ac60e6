#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace quarn {

/// A picture of 8-bit sRGB pixels: red, green, blue and opacity, by which the colours are not
/// multiplied. Rows run from the top of the picture to its bottom.
struct Image {
    int width = 0;                  ///< pixels
    int height = 0;                 ///< pixels
    std::vector<std::uint8_t> rgba; ///< 4 * width * height bytes

    /// Sets the size. The storage only grows, so that drawing frames of one size allocates once.
    /// Nothing changes when memory lacks (std::bad_alloc).
    void resize(int new_width, int new_height) {
        rgba.resize(std::size_t{4} * static_cast<std::size_t>(new_width) *
                    static_cast<std::size_t>(new_height));
        width = new_width;
        height = new_height;
    }

    /// The four bytes of a pixel, counted from the upper left corner; it must lie in the picture.
    std::span<const std::uint8_t, 4> pixel(int x, int y) const {
        return std::span<const std::uint8_t, 4>(rgba.data() + 4 * offset(x, y), 4);
    }

private:
    std::size_t offset(int x, int y) const {
        return static_cast<std::size_t>(y) * static_cast<std::size_t>(width) +
               static_cast<std::size_t>(x);
    }
};

/// How near the surface is that a pixel shows. Values are linear along straight lines of the
/// screen, so they may be interpolated between pixels: in a perspective view 1 / depth, in a
/// parallel view `reference_depth` - depth, where depth is the distance from the camera along the
/// view direction in model units. Larger is nearer; 0 where no surface is seen.
struct DepthImage {
    int width = 0;
    int height = 0;
    bool parallel = false;
    float reference_depth = 0.0F;
    std::vector<float> nearness; ///< width * height, rows from the top

    /// Depth of a pixel in model units; infinite where no surface is seen.
    float depth(int x, int y) const;

    /// Sets the size; the storage only grows.
    void resize(int new_width, int new_height);
};

} // namespace quarn
