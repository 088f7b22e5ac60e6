#include "engine/display/FreeSky.h"

#include "engine/display/FlushDenormals.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <array>
#include <cmath>

namespace quarn {

namespace {

/// Places of a task's block; a multiple of what the ray loops take together.
constexpr int block_size = 32;
constexpr float two_pi = 6.28318531F;

/// The four lowest bits in reverse order, as a part of 1.
float reversed(int bits, int count) {
    int result = 0;
    for (int i = 0; i < count; ++i)
        result |= (bits >> i & 1) << (count - 1 - i);
    return static_cast<float>(result);
}

/// The k-th of the `rays` directions that place `lane` of a tile takes. They lie in equal sectors
/// around the normal, one in each; the sixteen places divide each sector among themselves in angle
/// and, in another order, in elevation: the points of J. M. Hammersley, "Monte Carlo Methods for
/// Solving Multivariable Problems", Annals of the New York Academy of Sciences, 1960.
void setDirection(int k, int rays, int lane, SkyDirections& d) {
    const int column = lane % tile_size;
    const int row = lane / tile_size;
    const int mixed = (column + 2 * row) % tile_size + tile_size * row;
    const float sector =
        static_cast<float>(k) + (static_cast<float>(mixed) + 0.5F) / static_cast<float>(lane_count);
    const float turn = two_pi * sector / static_cast<float>(rays);
    const float ring =
        reversed(mixed, 4) + (static_cast<float>(k) + 0.5F) / static_cast<float>(rays);
    const float u = ring / static_cast<float>(lane_count);
    const float sine = std::sqrt(u);
    d.x[lane] = sine * std::cos(turn);
    d.y[lane] = sine * std::sin(turn);
    d.z[lane] = std::sqrt(1.0F - u);
    const int step = (k * 5 + mixed * 7) % lane_count;
    d.reach[lane] = 0.06F + 0.94F * (static_cast<float>(step) + 0.5F) / 16.0F;
}

SkyTable makeDirections() {
    SkyTable table{};
    for (int lane = 0; lane < lane_count; ++lane) {
        for (int k = 0; k < sky_rays; ++k)
            setDirection(k, sky_rays, lane, table.shared[k]);
        setDirection(0, 1, lane, table.alone);
    }
    return table;
}

const SkyTable& skyTable() {
    static const SkyTable table = makeDirections();
    return table;
}

/// Calls function(row) for all rows of the grid, on all processors.
template <class Function> void forEachRow(int height, const Function& function) {
    tbb::parallel_for(0, height, [&](int row) {
        const FlushDenormals flush;
        function(row);
    });
}

float dot(const float (&a)[3], const float (&b)[3]) {
    return a[0] * b[0] + a[1] * b[1] + a[2] * b[2];
}

/// True if two places show the same part of a surface.
bool areAlike(const SkyPlace& a, const SkyPlace& b, float sky_reach) {
    if (dot(a.normal, b.normal) < sky_least_facing)
        return false;
    const float apart[3] = {b.point[0] - a.point[0], b.point[1] - a.point[1],
                            b.point[2] - a.point[2]};
    const float tolerance =
        sky_step_of_reach * sky_reach + sky_step_of_slope * std::sqrt(dot(apart, apart));
    return std::max(std::fabs(dot(a.normal, apart)), std::fabs(dot(b.normal, apart))) < tolerance;
}

} // namespace

void FreeSky::find(FrameSetup& frame, const RayKernel& kernel) {
    frame.sky_width = (frame.width + sky_spacing - 1) / sky_spacing;
    frame.sky_height = (frame.height + sky_spacing - 1) / sky_spacing;
    const std::size_t count =
        static_cast<std::size_t>(frame.sky_width) * static_cast<std::size_t>(frame.sky_height);
    m_places.resize(count);
    m_free.resize(count);
    m_smoothed.resize(count);
    frame.sky_table = &skyTable();
    frame.sky_places = m_places.data();
    frame.free_sky = m_free.data();
    const int columns = (frame.sky_width + block_size - 1) / block_size;
    const int rows = (frame.sky_height + block_size - 1) / block_size;
    tbb::parallel_for(0, columns * rows, [&](int index) {
        const FlushDenormals flush;
        const int x = index % columns * block_size;
        const int y = index / columns * block_size;
        kernel.find_free_sky(frame, {x, y, std::min(frame.sky_width, x + block_size),
                                     std::min(frame.sky_height, y + block_size)});
    });
    // Four in a row and four rows are a tile, wherever it begins; the second time, the other way
    // about, so that the mean lies around its place.
    smooth(frame, 1, 0, {-2, 1});
    smooth(frame, 0, 1, {-2, 1});
    smooth(frame, 1, 0, {-1, 2});
    smooth(frame, 0, 1, {-1, 2});
    frame.free_sky = m_free.data();
}

/// Replaces each place by the mean of some in its row or column that show the same surface.
void FreeSky::smooth(const FrameSetup& frame, int dx, int dy, Span span) {
    forEachRow(frame.sky_height, [&](int y) {
        for (int x = 0; x < frame.sky_width; ++x) {
            const auto offset = [&](int i) {
                return static_cast<std::size_t>(y + i * dy) *
                           static_cast<std::size_t>(frame.sky_width) +
                       static_cast<std::size_t>(x + i * dx);
            };
            const int at = dx != 0 ? x : y;
            const int count = dx != 0 ? frame.sky_width : frame.sky_height;
            const int first = std::max(span.first, -at);
            const int last = std::min(span.last, count - 1 - at);
            const float own = m_free[offset(0)];
            float sum = own;
            float weights = 1.0F;
            for (int i = first; i <= last; ++i) {
                const float other = m_free[offset(i)];
                // What is equal changes no mean, so it need not be compared: open ground is quick.
                if (i == 0 || other == own) {
                    sum += i == 0 ? 0.0F : own;
                    weights += i == 0 ? 0.0F : 1.0F;
                    continue;
                }
                if (!areAlike(m_places[offset(0)], m_places[offset(i)], frame.sky_reach))
                    continue;
                sum += other;
                weights += 1.0F;
            }
            m_smoothed[offset(0)] = sum / weights;
        }
    });
    m_free.swap(m_smoothed);
}

} // namespace quarn
