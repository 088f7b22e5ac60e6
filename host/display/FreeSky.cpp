#include "host/display/FreeSky.h"

#include "host/display/FlushDenormals.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <array>
#include <cmath>

namespace quarn {

namespace {

constexpr int block_width = 64;
constexpr int block_height = 32;
constexpr float two_pi = 6.28318531F;
/// What a neighbour may lie above or below a pixel's plane, as a part of the reach.
constexpr float step_of_reach = 0.06F;

/// The four lowest bits in reverse order, as a part of 1.
float reversed(int bits, int count) {
    int result = 0;
    for (int i = 0; i < count; ++i)
        result |= (bits >> i & 1) << (count - 1 - i);
    return static_cast<float>(result);
}

/// The rays of a pixel lie in equal sectors around the normal, one in each; the sixteen pixels of a
/// tile divide each sector among themselves, in angle and in elevation.
std::array<SkyDirections, sky_rays> makeDirections() {
    std::array<SkyDirections, sky_rays> all{};
    for (int k = 0; k < sky_rays; ++k)
        for (int lane = 0; lane < lane_count; ++lane) {
            const int column = lane % tile_size;
            const int row = lane / tile_size;
            const int mixed = (column + 2 * row) % tile_size + tile_size * row;
            const float sector = static_cast<float>(k) + (static_cast<float>(column) + 0.5F) / 4.0F;
            const float turn = two_pi * sector / static_cast<float>(sky_rays);
            const float ring =
                reversed(mixed, 4) + (static_cast<float>(k * 3 % sky_rays) + 0.5F) / sky_rays;
            const float u = ring / static_cast<float>(lane_count);
            const float sine = std::sqrt(u);
            SkyDirections& d = all[static_cast<std::size_t>(k)];
            d.x[lane] = sine * std::cos(turn);
            d.y[lane] = sine * std::sin(turn);
            d.z[lane] = std::sqrt(1.0F - u);
            const int step = (k * 5 + mixed * 7) % lane_count;
            d.reach[lane] = 0.06F + 0.94F * (static_cast<float>(step) + 0.5F) / 16.0F;
        }
    return all;
}

const std::array<SkyDirections, sky_rays>& skyDirections() {
    static const std::array<SkyDirections, sky_rays> directions = makeDirections();
    return directions;
}

/// Calls function(row) for all rows of a picture, on all processors.
template <class Function> void forEachRow(int height, const Function& function) {
    tbb::parallel_for(0, height, [&](int row) {
        const FlushDenormals flush;
        function(row);
    });
}

/// Where the pixels' middles meet the surfaces.
class PixelPlaces {
public:
    explicit PixelPlaces(const FrameSetup& frame) : m_frame(frame) {}

    /// How much two pixels show the same part of a surface, 0 to 1.
    float likeness(int ax, int ay, int bx, int by) const {
        const SkyPlace& a = at(ax, ay);
        const SkyPlace& b = at(bx, by);
        if (a.distance < 0.0F || b.distance < 0.0F)
            return 0.0F;
        const float facing = dot(a.normal, b.normal);
        if (facing < 0.7F)
            return 0.0F;
        float p[3];
        float q[3];
        place(ax, ay, a.distance, p);
        place(bx, by, b.distance, q);
        const float apart[3] = {q[0] - p[0], q[1] - p[1], q[2] - p[2]};
        const float tolerance =
            step_of_reach * m_frame.sky_reach + 0.25F * std::sqrt(dot(apart, apart));
        const float step =
            std::max(std::fabs(dot(a.normal, apart)), std::fabs(dot(b.normal, apart)));
        return step < tolerance ? 1.0F : 0.0F;
    }

private:
    static float dot(const float (&a)[3], const float (&b)[3]) {
        return a[0] * b[0] + a[1] * b[1] + a[2] * b[2];
    }
    const SkyPlace& at(int x, int y) const {
        return m_frame
            .sky_places[static_cast<std::size_t>(y) * static_cast<std::size_t>(m_frame.width) +
                        static_cast<std::size_t>(x)];
    }
    void place(int x, int y, float distance, float (&p)[3]) const {
        const CameraRays& c = m_frame.rays;
        const float u = static_cast<float>(x) + 0.5F;
        const float v = static_cast<float>(y) + 0.5F;
        for (int i = 0; i < 3; ++i)
            p[i] = c.origin[i] + u * c.origin_dx[i] + v * c.origin_dy[i] +
                   distance * (c.direction[i] + u * c.direction_dx[i] + v * c.direction_dy[i]);
    }

    const FrameSetup& m_frame;
};

} // namespace

void FreeSky::find(FrameSetup& frame, const RayKernel& kernel) {
    const std::size_t count =
        static_cast<std::size_t>(frame.width) * static_cast<std::size_t>(frame.height);
    m_places.resize(count);
    m_free.resize(count);
    m_smoothed.resize(count);
    frame.sky_directions = skyDirections().data();
    frame.sky_places = m_places.data();
    frame.free_sky = m_free.data();
    const int columns = (frame.width + block_width - 1) / block_width;
    const int rows = (frame.height + block_height - 1) / block_height;
    tbb::parallel_for(0, columns * rows, [&](int index) {
        const FlushDenormals flush;
        const int x = index % columns * block_width;
        const int y = index / columns * block_height;
        kernel.find_free_sky(frame, {x, y, std::min(frame.width, x + block_width),
                                     std::min(frame.height, y + block_height)});
    });
    // Four in a row and four rows are a tile, wherever it begins; the second time, the other way
    // about, so that the mean lies around its pixel.
    smooth(frame, 1, 0, 2);
    smooth(frame, 0, 1, 2);
    smooth(frame, 1, 0, 1);
    smooth(frame, 0, 1, 1);
    frame.free_sky = m_free.data();
}

/// Replaces each pixel by the mean of four in a row or column, from `before` before it on, that
/// show the same surface.
void FreeSky::smooth(const FrameSetup& frame, int dx, int dy, int before) {
    const PixelPlaces places(frame);
    forEachRow(frame.height, [&](int y) {
        for (int x = 0; x < frame.width; ++x) {
            const auto offset = [&](int i) {
                return static_cast<std::size_t>(y + i * dy) *
                           static_cast<std::size_t>(frame.width) +
                       static_cast<std::size_t>(x + i * dx);
            };
            const int at = dx != 0 ? x : y;
            const int first = std::max(-before, -at);
            const int last =
                std::min(tile_size - before, (dx != 0 ? frame.width : frame.height) - at);
            const float own = m_free[offset(0)];
            float sum = own;
            float weights = 1.0F;
            for (int i = first; i < last; ++i) {
                const float other = m_free[offset(i)];
                // What is equal changes no mean, so it need not be compared: open ground is quick.
                if (i == 0 || other == own) {
                    sum += i == 0 ? 0.0F : own;
                    weights += i == 0 ? 0.0F : 1.0F;
                    continue;
                }
                const float weight = places.likeness(x, y, x + i * dx, y + i * dy);
                sum += weight * other;
                weights += weight;
            }
            m_smoothed[offset(0)] = sum / weights;
        }
    });
    m_free.swap(m_smoothed);
}

} // namespace quarn
