#include "import/assembly/CornerGrid.h"

#include <cmath>
#include <limits>

namespace quarn {

namespace {

constexpr double MOST_CELLS = 1e6; ///< along one axis

} // namespace

void CornerGrid::fill(std::span<const Place> places, std::span<const std::uint32_t> corners) {
    m_across = axisOf(places, &Place::x);
    m_up = axisOf(places, &Place::y);
    const auto count = static_cast<double>(corners.size());
    divide(m_across, std::sqrt(count * m_across.length / m_up.length)); // cells are about square
    divide(m_up, count / static_cast<double>(m_across.cells));
    const auto cellOf = [&](std::uint32_t corner) {
        return rowAt(places[corner].y) * m_across.cells + columnAt(places[corner].x);
    };
    // Counts are summed up to where each cell ends; filling it from behind leaves where it begins.
    m_begin.assign(m_across.cells * m_up.cells + 1, 0);
    for (const std::uint32_t corner : corners)
        ++m_begin[cellOf(corner)];
    std::uint32_t end = 0;
    for (std::uint32_t& begin : m_begin)
        begin = end += begin;
    m_corners.resize(corners.size());
    for (const std::uint32_t corner : corners)
        m_corners[--m_begin[cellOf(corner)]] = corner;
}

CornerGrid::Axis CornerGrid::axisOf(std::span<const Place> places, double Place::*coordinate) {
    double low = std::numeric_limits<double>::max();
    double high = std::numeric_limits<double>::lowest();
    for (const Place& place : places)
        if (std::isfinite(place.*coordinate)) {
            low = std::min(low, place.*coordinate);
            high = std::max(high, place.*coordinate);
        }
    const double length = high - low;
    return length > 0.0 && std::isfinite(length) ? Axis{low, length} : Axis{};
}

void CornerGrid::divide(Axis& axis, double cells) {
    const double cells_per_length = std::floor(cells) / axis.length;
    if (!(cells >= 1.0 && cells <= MOST_CELLS && std::isfinite(cells_per_length)))
        return;
    axis.cells = static_cast<std::size_t>(cells);
    axis.cells_per_length = cells_per_length;
}

} // namespace quarn
