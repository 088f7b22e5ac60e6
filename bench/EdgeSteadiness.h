#pragma once

#include "engine/display/CameraRays.h"
#include "engine/display/kernel/FrameSetup.h"
#include "engine/images/Image.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <vector>

/// How much the edges of an animation crawl, in numbers. Each edge pixel of a frame is carried to
/// where its surface lies in the next frame, and the colours are compared. Edges that move with
/// their surfaces and nothing else leave no difference. For perspective views, whose nearness is
/// one by depth.
namespace bench {

/// What a frame shows besides its colours, of the pixels' middles.
struct FrameShape {
    quarn::CameraRays rays;
    quarn::DepthImage depth;
    std::vector<std::uint8_t> edges; ///< not 0 for edge pixels
};

/// A place in the next frame.
struct CarriedPixel {
    int x = 0; ///< the pixel in this frame
    int y = 0;
    float next_x = 0.0F; ///< continuous pixels of the next frame
    float next_y = 0.0F;
};

/// How far a surface must lie behind another, as a share of the distance, to be another one.
inline constexpr float depth_step = 0.02F;

inline float nearnessAt(const quarn::DepthImage& depth, int x, int y) {
    return depth.nearness[static_cast<std::size_t>(y) * static_cast<std::size_t>(depth.width) +
                          static_cast<std::size_t>(x)];
}

/// The nearest surface in a pixel or beside it: an edge moves with what lies before it.
inline float nearestAround(const quarn::DepthImage& depth, int x, int y) {
    float nearest = 0.0F;
    for (int j = std::max(0, y - 1); j <= std::min(depth.height - 1, y + 1); ++j)
        for (int i = std::max(0, x - 1); i <= std::min(depth.width - 1, x + 1); ++i)
            nearest = std::max(nearest, nearnessAt(depth, i, j));
    return nearest;
}

inline bool colorSteps(const quarn::Image& image, int x, int y, int other_x, int other_y) {
    for (std::size_t c = 0; c < 3; ++c)
        if (std::abs(image.pixel(x, y)[c] - image.pixel(other_x, other_y)[c]) > quarn::visible_step)
            return true;
    return false;
}

/// Whether nearness is bent between three pixels in a row. Along a plane it is straight.
inline bool depthSteps(float before, float here, float after) {
    return std::abs(before - 2.0F * here + after) >
           depth_step * std::max({before, here, after, 1e-20F});
}

/// Marks the pixels where the picture has a step of colour or of depth to a neighbour.
/// @param image  drawn without smoothing
inline std::vector<std::uint8_t> findEdges(const quarn::Image& image,
                                           const quarn::DepthImage& depth) {
    std::vector<std::uint8_t> edges(depth.nearness.size(), 0);
    for (int y = 1; y + 1 < image.height; ++y)
        for (int x = 1; x + 1 < image.width; ++x) {
            const auto near = [&](int i, int j) { return nearnessAt(depth, x + i, y + j); };
            const bool edge =
                colorSteps(image, x, y, x - 1, y) || colorSteps(image, x, y, x + 1, y) ||
                colorSteps(image, x, y, x, y - 1) || colorSteps(image, x, y, x, y + 1) ||
                depthSteps(near(-1, 0), near(0, 0), near(1, 0)) ||
                depthSteps(near(0, -1), near(0, 0), near(0, 1));
            edges[static_cast<std::size_t>(y) * static_cast<std::size_t>(image.width) +
                  static_cast<std::size_t>(x)] = edge ? 1 : 0;
        }
    return edges;
}

/// Carries places of one frame into the next.
class FrameCarrier {
public:
    FrameCarrier(const FrameShape& from, const FrameShape& to) : m_from(from), m_to(to) {}

    /// Edge pixels whose surface is seen in the next frame too: what leaves the picture, shows no
    /// surface or goes behind another one is left out.
    std::vector<CarriedPixel> carryEdges() const {
        std::vector<CarriedPixel> carried;
        for (int y = 0; y < m_from.depth.height; ++y)
            for (int x = 0; x < m_from.depth.width; ++x) {
                CarriedPixel pixel{x, y};
                if (isEdge(x, y) && carry(pixel))
                    carried.push_back(pixel);
            }
        return carried;
    }

private:
    bool isEdge(int x, int y) const {
        return m_from.edges[static_cast<std::size_t>(y) *
                                static_cast<std::size_t>(m_from.depth.width) +
                            static_cast<std::size_t>(x)] != 0;
    }

    bool carry(CarriedPixel& pixel) const {
        const float nearness = nearestAround(m_from.depth, pixel.x, pixel.y);
        if (nearness <= 0.0F)
            return false;
        double world[3];
        placeOf(static_cast<double>(pixel.x) + 0.5, static_cast<double>(pixel.y) + 0.5, nearness,
                world);
        float next_nearness = 0.0F;
        if (!project(world, pixel, next_nearness))
            return false;
        const float seen = nearestAround(m_to.depth, static_cast<int>(pixel.next_x),
                                         static_cast<int>(pixel.next_y));
        return std::abs(seen - next_nearness) <= depth_step * next_nearness;
    }

    /// The world's point that the ray through a place of this frame meets.
    void placeOf(double x, double y, float nearness, double (&world)[3]) const {
        const quarn::CameraRays& rays = m_from.rays;
        for (int i = 0; i < 3; ++i)
            world[i] = rays.origin[i] +
                       (rays.direction[i] + x * rays.direction_dx[i] + y * rays.direction_dy[i]) /
                           nearness;
    }

    /// @return false where the point lies behind the camera or outside the next frame's middle
    bool project(const double (&world)[3], CarriedPixel& pixel, float& nearness) const {
        const quarn::CameraRays& rays = m_to.rays;
        double place[3] = {0.0, 0.0, 0.0}; // in the camera's own frame
        for (int i = 0; i < 3; ++i) {
            const double from_eye = world[i] - rays.eye[i];
            place[0] += from_eye * rays.camera_x[i];
            place[1] += from_eye * rays.camera_y[i];
            place[2] -= from_eye * rays.camera_z[i];
        }
        if (place[2] <= 0.0)
            return false;
        const double x = (place[0] / place[2] - rays.left) / rays.pixel_width;
        const double y = (rays.top - place[1] / place[2]) / double{rays.pixel_size};
        nearness = static_cast<float>(1.0 / place[2]);
        pixel.next_x = static_cast<float>(x);
        pixel.next_y = static_cast<float>(y);
        return x >= 1.0 && y >= 1.0 && x <= m_to.depth.width - 1 && y <= m_to.depth.height - 1;
    }

    const FrameShape& m_from;
    const FrameShape& m_to;
};

/// A sum of differences of colours, in steps of a channel's 255.
class ColorDifference {
public:
    void add(double a, double b) {
        const double difference = std::abs(a - b);
        m_sum += difference;
        m_squares += difference * difference;
        ++m_count;
    }
    double mean() const { return m_count == 0 ? 0.0 : m_sum / static_cast<double>(m_count); }
    double rootMeanSquare() const {
        return m_count == 0 ? 0.0 : std::sqrt(m_squares / static_cast<double>(m_count));
    }
    /// Channels of pixels that were compared.
    std::size_t count() const { return m_count; }

private:
    double m_sum = 0.0;
    double m_squares = 0.0;
    std::size_t m_count = 0;
};

/// A channel between the middles of four pixels; (x, y) in continuous pixels, at least half a pixel
/// inside the picture.
inline double channelAt(const quarn::Image& image, float x, float y, std::size_t channel) {
    const float left = std::clamp(std::floor(x - 0.5F), 0.0F, static_cast<float>(image.width - 2));
    const float top = std::clamp(std::floor(y - 0.5F), 0.0F, static_cast<float>(image.height - 2));
    const double u = double{x} - 0.5 - double{left};
    const double v = double{y} - 0.5 - double{top};
    const auto at = [&](int i, int j) {
        return double{1.0} *
               image.pixel(static_cast<int>(left) + i, static_cast<int>(top) + j)[channel];
    };
    return (1.0 - v) * ((1.0 - u) * at(0, 0) + u * at(1, 0)) +
           v * ((1.0 - u) * at(0, 1) + u * at(1, 1));
}

/// Adds what edges changed from a frame to the next.
inline void addResidual(const std::vector<CarriedPixel>& carried, const quarn::Image& frame,
                        const quarn::Image& next, ColorDifference& residual) {
    for (const CarriedPixel& pixel : carried)
        for (std::size_t c = 0; c < 3; ++c)
            residual.add(frame.pixel(pixel.x, pixel.y)[c],
                         channelAt(next, pixel.next_x, pixel.next_y, c));
}

} // namespace bench
