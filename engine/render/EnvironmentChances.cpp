#include "engine/render/EnvironmentChances.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <numeric>

namespace quarn {

namespace {

/// Each cell is looked at in so many places a side.
constexpr int PLACES = 2;
constexpr float LEAST_PREFERENCE = 0.05F;

struct Direction {
    float at[3];
    float part; ///< of all directions, beside one at a corner of the octahedron
};

/// The direction at a place of the octahedron folded open, see EnvironmentLight.h.
/// @param u, v  from -1 to 1
Direction unfolded(float u, float v) {
    float p[3] = {u, v, 1.0F - std::abs(u) - std::abs(v)};
    if (p[2] < 0.0F) {
        p[0] = std::copysign(1.0F - std::abs(v), u);
        p[1] = std::copysign(1.0F - std::abs(u), v);
    }
    const float length = std::hypot(p[0], p[1], p[2]);
    return {{p[0] / length, p[1] / length, p[2] / length}, 1.0F / (length * length * length)};
}

float luminance(const float (&colors)[3][lane_count], int lane) {
    return 0.2126F * colors[0][lane] + 0.7152F * colors[1][lane] + 0.0722F * colors[2][lane];
}

/// Turns numbers into their sums so far, as parts of the whole, which is given back.
template <class Iterator> float sumUp(Iterator first, int count) {
    double sum = 0.0;
    for (int i = 0; i < count; ++i) {
        const double number = first[i];
        first[i] = static_cast<float>(sum);
        sum += number;
    }
    for (int i = 0; i < count; ++i)
        first[i] = sum > 0.0 ? static_cast<float>(first[i] / sum) : 0.0F;
    first[count] = 1.0F;
    return static_cast<float>(sum);
}

} // namespace

EnvironmentChances::Brightness EnvironmentChances::brightnessAround(const FrameSetup& frame,
                                                                    const RenderKernel& kernel) {
    constexpr int lanes_a_row = side * PLACES;
    static_assert(lanes_a_row % lane_count == 0);
    constexpr float step = 2.0F / lanes_a_row;
    Brightness found;
    found.of_cell.assign(std::size_t{side} * side, 0.0F);
    alignas(64) float directions[3][lane_count];
    alignas(64) float colors[3][lane_count];
    float parts[lane_count];
    double sum = 0.0;
    double whole = 0.0;
    for (int y = 0; y < lanes_a_row; ++y)
        for (int x = 0; x < lanes_a_row; x += lane_count) {
            for (int lane = 0; lane < lane_count; ++lane) {
                const Direction direction =
                    unfolded((static_cast<float>(x + lane) + 0.5F) * step - 1.0F,
                             (static_cast<float>(y) + 0.5F) * step - 1.0F);
                for (int axis = 0; axis < 3; ++axis)
                    directions[axis][lane] = direction.at[axis];
                parts[lane] = direction.part;
            }
            kernel.light_around(frame, directions, colors);
            for (int lane = 0; lane < lane_count; ++lane) {
                const float bright = luminance(colors, lane);
                found.most = std::max(found.most, bright);
                const auto cell = static_cast<std::size_t>(y / PLACES * side + (x + lane) / PLACES);
                found.of_cell[cell] += bright * parts[lane];
                sum += bright * parts[lane];
                whole += parts[lane];
            }
        }
    found.mean = static_cast<float>(sum / whole);
    return found;
}

void EnvironmentChances::find(const FrameSetup& frame, const RenderKernel& kernel) {
    m_rows.clear();
    const Brightness bright = brightnessAround(frame, kernel);
    if (!(bright.most > least_unevenness * bright.mean))
        return;
    constexpr auto cells = std::size_t{side} * side;
    const double all = std::accumulate(bright.of_cell.begin(), bright.of_cell.end(), 0.0);
    const auto least = static_cast<float>(LEAST_PREFERENCE * all / static_cast<double>(cells));
    m_rows.resize(side + 1);
    m_cells.resize(std::size_t{side} * (side + 1));
    m_density.resize(cells);
    double sum = 0.0;
    for (std::size_t i = 0; i < cells; ++i) {
        m_density[i] = std::max(bright.of_cell[i], least);
        sum += m_density[i];
    }
    for (int row = 0; row < side; ++row) {
        const auto first = m_cells.begin() + static_cast<std::ptrdiff_t>(row) * (side + 1);
        std::copy_n(m_density.begin() + static_cast<std::ptrdiff_t>(row) * side, side, first);
        m_rows[static_cast<std::size_t>(row)] = sumUp(first, side);
    }
    sumUp(m_rows.begin(), side);
    // The square from -1 to 1 has an area of 4.
    const auto by_area = static_cast<float>(static_cast<double>(cells) / (4.0 * sum));
    for (float& density : m_density)
        density *= by_area;
}

EnvironmentTable EnvironmentChances::table() const {
    if (m_rows.empty())
        return {};
    return {m_rows.data(), m_cells.data(), m_density.data()};
}

} // namespace quarn
