#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace quarn {

/// How crowded with lines each part of a picture is. A dense net of lines would be a black spot:
/// where lines crowd, each is drawn the lighter, so that its parts can still be told apart.
class LineCrowding {
public:
    /// Side of a cell, in pixels.
    static constexpr int cell_size = 16;
    /// Lines that cover less than this part of a cell are drawn in full.
    static constexpr float sparse = 0.10F;

    /// Starts anew for a picture of this size; keeps the storage.
    void reset(int width, int height);
    /// Adds lines' area at a place of the picture. Different rows of cells may be filled by
    /// different threads.
    void add(float x, float y, float square_pixels);
    /// Turns areas into strengths; call it once, after the last `add`.
    void finish();
    /// How strong a line is at the middle of a pixel: 1 where it stands free. Changes smoothly.
    float strength(int x, int y) const;

private:
    std::size_t cell(int column, int row) const {
        return static_cast<std::size_t>(row) * static_cast<std::size_t>(m_columns) +
               static_cast<std::size_t>(column);
    }

    int m_columns = 0;
    int m_rows = 0;
    std::vector<float> m_cells;
};

} // namespace quarn
