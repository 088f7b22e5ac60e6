#pragma once

#include "bench/EdgeSteadiness.h"
#include "engine/display/DisplayPipeline.h"
#include "engine/display/DisplayScene.h"
#include "engine/images/ColorSpace.h"
#include "ground/Result.h"
#include "kelmar/KM_Viewport.h"

#include <array>
#include <cmath>
#include <cstddef>

namespace bench {

/// A camera that looks at a model's middle and goes around it.
struct Orbit {
    KM_3dPoint target;
    double radius = 1.0;     ///< model units
    double raised_deg = 0.0; ///< above the horizon
    double start_deg = 0.0;  ///< around z, from x toward y
    double lens_mm = 50.0;   ///< of a 35 mm camera

    KM_Viewport at(double turned_deg) const {
        const double around = (start_deg + turned_deg) * KM_PI / 180.0;
        const double up = raised_deg * KM_PI / 180.0;
        const KM_3dVector out(std::cos(up) * std::cos(around), std::cos(up) * std::sin(around),
                              std::sin(up));
        KM_Viewport viewport;
        viewport.SetCameraLocation(target + radius * out);
        viewport.SetCameraDirection(-out);
        viewport.SetCameraUp(KM_3dVector::ZAxis);
        viewport.SetCamera35mmLensLength(lens_mm);
        return viewport;
    }
};

/// The mean of blocks of 8 by 8 pixels in linear light: 64 rays a pixel.
inline void averageBlocks(const quarn::Image& fine, quarn::Image& image) {
    image.resize(fine.width / 8, fine.height / 8);
    for (int y = 0; y < image.height; ++y)
        for (int x = 0; x < image.width; ++x) {
            float sum[3] = {0.0F, 0.0F, 0.0F};
            for (int j = 0; j < 8; ++j)
                for (int i = 0; i < 8; ++i)
                    for (std::size_t c = 0; c < 3; ++c)
                        sum[c] += quarn::linearFromSrgbByte(fine.pixel(8 * x + i, 8 * y + j)[c]);
            const std::size_t at =
                4 * (static_cast<std::size_t>(y) * static_cast<std::size_t>(image.width) +
                     static_cast<std::size_t>(x));
            for (std::size_t c = 0; c < 3; ++c)
                image.rgba[at + c] = quarn::srgbByteFromLinear(sum[c] / 64.0F);
            image.rgba[at + 3] = 255;
        }
}

/// Draws a turntable of one degree a frame at every level of smoothing, and with 64 rays a pixel,
/// and compares them.
class SteadyTurntable {
public:
    static constexpr std::size_t level_count = 3;
    static constexpr std::size_t reference = level_count; ///< place of the 64 rays in `residual`

    struct Comparison {
        /// Mean change of an edge pixel from frame to frame, by level and for the reference.
        std::array<ColorDifference, level_count + 1> residual;
        /// How far edge pixels are from the reference, by level.
        std::array<ColorDifference, level_count> error;
    };

    SteadyTurntable(const quarn::DisplayScene& scene, const Orbit& orbit, int width, int height)
        : m_scene(scene), m_orbit(orbit), m_width(width), m_height(height) {}

    /// @param frame_count  at least two
    /// @return an error when a frame cannot be drawn
    quarn::Result<Comparison> compare(const quarn::DisplayModeAttributes& mode, int frame_count) {
        Comparison comparison;
        Frame earlier;
        for (int i = 0; i < frame_count; ++i) {
            Frame frame;
            if (const auto drawn = draw(mode, m_orbit.at(i), frame); !drawn)
                return drawn.error();
            addErrors(frame, comparison);
            if (i > 0)
                addResiduals(earlier, frame, comparison);
            earlier = std::move(frame);
        }
        return comparison;
    }

private:
    struct Frame {
        FrameShape shape;
        std::array<quarn::Image, level_count + 1> images;
    };

    quarn::Result<void> draw(quarn::DisplayModeAttributes mode, const KM_Viewport& viewport,
                             Frame& frame) {
        frame.shape.rays = quarn::cameraRays(viewport, m_width, m_height, m_scene.boundingBox());
        for (std::size_t level = 0; level < level_count; ++level) {
            mode.antialiasing_level = static_cast<int>(level);
            const auto drawn = m_pipeline.draw(m_scene, viewport, mode, m_width, m_height,
                                               frame.images[level], &frame.shape.depth);
            if (!drawn)
                return drawn;
        }
        frame.shape.edges = findEdges(frame.images[0], frame.shape.depth);
        mode.antialiasing_level = 0;
        const auto drawn =
            m_pipeline.draw(m_scene, viewport, mode, 8 * m_width, 8 * m_height, m_fine);
        if (drawn)
            averageBlocks(m_fine, frame.images[reference]);
        return drawn;
    }

    static void addErrors(const Frame& frame, Comparison& comparison) {
        const quarn::Image& wanted = frame.images[reference];
        for (std::size_t pixel = 0; pixel < frame.shape.edges.size(); ++pixel)
            for (std::size_t c = 0; c < 3 && frame.shape.edges[pixel] != 0; ++c)
                for (std::size_t level = 0; level < level_count; ++level)
                    comparison.error[level].add(frame.images[level].rgba[4 * pixel + c],
                                                wanted.rgba[4 * pixel + c]);
    }

    static void addResiduals(const Frame& frame, const Frame& next, Comparison& comparison) {
        const auto carried = FrameCarrier(frame.shape, next.shape).carryEdges();
        for (std::size_t i = 0; i < comparison.residual.size(); ++i)
            addResidual(carried, frame.images[i], next.images[i], comparison.residual[i]);
    }

    const quarn::DisplayScene& m_scene;
    Orbit m_orbit;
    int m_width;
    int m_height;
    quarn::DisplayPipeline m_pipeline;
    quarn::Image m_fine;
};

} // namespace bench
