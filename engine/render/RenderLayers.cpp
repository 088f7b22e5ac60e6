#include "engine/render/RenderLayers.h"

namespace quarn {

RenderLayers::RenderLayers(int width, int height) : m_width(width), m_height(height) {
    m_sums.tile_columns = (width + tile_size - 1) / tile_size;
    const std::size_t tiles = static_cast<std::size_t>(m_sums.tile_columns) *
                              static_cast<std::size_t>((height + tile_size - 1) / tile_size);
    m_storage = AlignedNumbers(tiles * lane_count * RenderPlane::count);
    m_done.resize(tiles);
    m_sums.done = m_done.data();
    for (std::size_t plane = 0; plane < RenderPlane::count; ++plane)
        m_sums.planes[plane] = m_storage.data() + plane * tiles * lane_count;
}

} // namespace quarn
