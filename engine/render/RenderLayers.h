#pragma once

#include "engine/render/AlignedNumbers.h"
#include "engine/render/kernel/RenderSetup.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace quarn {

/// The sums of a picture's samples.
class RenderLayers {
public:
    RenderLayers(int width, int height);

    int width() const { return m_width; }
    int height() const { return m_height; }
    RenderSums sums() const { return m_sums; }

    /// Not 0 for the tiles that get no more samples, see RenderSums.
    std::vector<std::uint8_t>& done() { return m_done; }

    /// A sum of one pixel.
    float at(int plane, int x, int y) const { return m_sums.planes[plane][offset(x, y)]; }

    /// How many samples a pixel has so far.
    int samplesAt(int x, int y) const { return static_cast<int>(at(RenderPlane::samples, x, y)); }

    /// Bytes that a pixel takes.
    static constexpr std::size_t bytes_per_pixel = RenderPlane::count * sizeof(float);

private:
    std::size_t offset(int x, int y) const {
        const auto column = static_cast<std::size_t>(x);
        const auto row = static_cast<std::size_t>(y);
        const std::size_t tile =
            row / tile_size * static_cast<std::size_t>(m_sums.tile_columns) + column / tile_size;
        return tile * lane_count + row % tile_size * tile_size + column % tile_size;
    }

    int m_width;
    int m_height;
    RenderSums m_sums;
    AlignedNumbers m_storage;
    std::vector<std::uint8_t> m_done;
};

} // namespace quarn
