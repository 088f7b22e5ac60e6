#include "engine/display/LineCrowding.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// Strong enough to be seen as a tone, however many lines there are.
constexpr float weakest = 0.12F;

float strengthAt(float covered) {
    if (covered <= LineCrowding::sparse)
        return 1.0F;
    return std::max(weakest, std::pow(LineCrowding::sparse / covered, 0.56F));
}

int cellOf(float place, int count) {
    return std::clamp(static_cast<int>(place / static_cast<float>(LineCrowding::cell_size)), 0,
                      count - 1);
}

} // namespace

void LineCrowding::reset(int width, int height) {
    m_columns = (width + cell_size - 1) / cell_size;
    m_rows = (height + cell_size - 1) / cell_size;
    m_cells.assign(static_cast<std::size_t>(m_columns) * static_cast<std::size_t>(m_rows), 0.0F);
}

void LineCrowding::add(float x, float y, float square_pixels) {
    m_cells[cell(cellOf(x, m_columns), cellOf(y, m_rows))] += square_pixels;
}

void LineCrowding::finish() {
    constexpr float area = cell_size * cell_size;
    for (float& value : m_cells)
        value = strengthAt(value / area);
}

float LineCrowding::strength(int x, int y) const {
    constexpr float scale = 1.0F / cell_size;
    const float column = (static_cast<float>(x) + 0.5F) * scale - 0.5F;
    const float row = (static_cast<float>(y) + 0.5F) * scale - 0.5F;
    const float left = std::floor(column);
    const float top = std::floor(row);
    const int c0 = std::max(0, static_cast<int>(left));
    const int r0 = std::max(0, static_cast<int>(top));
    const int c1 = std::min(m_columns - 1, static_cast<int>(left) + 1);
    const int r1 = std::min(m_rows - 1, static_cast<int>(top) + 1);
    const float u = column - left;
    const float v = row - top;
    const float upper = (1.0F - u) * m_cells[cell(c0, r0)] + u * m_cells[cell(c1, r0)];
    const float lower = (1.0F - u) * m_cells[cell(c0, r1)] + u * m_cells[cell(c1, r1)];
    return (1.0F - v) * upper + v * lower;
}

} // namespace quarn
