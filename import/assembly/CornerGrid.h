#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace quarn {

/// Places in a plane, sorted into the cells of a grid with about as many cells as places, so that
/// those near a triangle are found without a look at all others. Keeps its memory from one filling
/// to the next.
class CornerGrid {
public:
    struct Place {
        double x;
        double y;
        bool operator==(const Place&) const = default;
    };

    /// @param places   stay where they are as long as the grid is asked; any numbers
    /// @param corners  numbers of those that are sorted
    void fill(std::span<const Place> places, std::span<const std::uint32_t> corners);

    /// True when `visit` says so for a corner; asks it about all that lie in the box of `a`, `b`
    /// and `c`, and some beside it.
    template <class Visit>
    bool anyNear(const Place& a, const Place& b, const Place& c, const Visit& visit) const {
        const auto [x_low, x_high] = std::minmax({a.x, b.x, c.x});
        const auto [y_low, y_high] = std::minmax({a.y, b.y, c.y});
        for (std::size_t row = rowAt(y_low); row <= rowAt(y_high); ++row) {
            const std::size_t end = m_begin[row * m_across.cells + columnAt(x_high) + 1];
            for (std::size_t i = m_begin[row * m_across.cells + columnAt(x_low)]; i < end; ++i)
                if (visit(m_corners[i]))
                    return true;
        }
        return false;
    }

private:
    /// One direction of the grid.
    struct Axis {
        double low = 0.0;
        double length = 0.0;
        double cells_per_length = 0.0;
        std::size_t cells = 1;
    };

    static Axis axisOf(std::span<const Place> places, double Place::*coordinate);
    static void divide(Axis& axis, double cells);
    static std::size_t cellAt(const Axis& axis, double coordinate) {
        const double cell = (coordinate - axis.low) * axis.cells_per_length;
        const auto last = static_cast<double>(axis.cells - 1);
        return cell > 0.0 ? static_cast<std::size_t>(std::min(cell, last)) : 0; // 0 for no number
    }
    std::size_t columnAt(double x) const { return cellAt(m_across, x); }
    std::size_t rowAt(double y) const { return cellAt(m_up, y); }

    Axis m_across;
    Axis m_up;
    std::vector<std::uint32_t> m_begin;   ///< by cell, and one past the last
    std::vector<std::uint32_t> m_corners; ///< by their cells
};

} // namespace quarn
