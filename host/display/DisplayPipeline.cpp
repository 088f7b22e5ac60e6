#include "host/display/DisplayPipeline.h"

#include "host/display/DisplayScene.h"
#include "host/display/FlushDenormals.h"
#include "host/display/FrameSetupBuilder.h"
#include "kelmar/KM_Viewport.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <string>

namespace quarn {

namespace {

/// Pixels of a task's block; neighbouring rays share what they read of the scene.
constexpr int block_width = 64;
constexpr int block_height = 32;

bool isValidSize(int size) {
    return size >= 1 && size <= DisplayPipeline::max_size_px;
}

void traceAll(const FrameSetup& frame, const RayKernel& kernel) {
    const int columns = (frame.width + block_width - 1) / block_width;
    const int rows = (frame.height + block_height - 1) / block_height;
    tbb::parallel_for(0, columns * rows, [&](int index) {
        const FlushDenormals flush;
        const int x = index % columns * block_width;
        const int y = index / columns * block_height;
        kernel.trace_block(frame, {x, y, std::min(frame.width, x + block_width),
                                   std::min(frame.height, y + block_height)});
    });
}

} // namespace

DisplayPipeline::DisplayPipeline() : m_kernel(&bestRayKernel()) {}

Result<void> DisplayPipeline::draw(const DisplayScene& scene, const KM_Viewport& viewport,
                                   const DisplayModeAttributes& mode, int width, int height,
                                   Image& image, DepthImage* depth) {
    if (!isValidSize(width) || !isValidSize(height))
        return Error{"A picture of " + std::to_string(width) + " by " + std::to_string(height) +
                     " pixels cannot be drawn: each side must be from 1 to " +
                     std::to_string(max_size_px) + "."};
    if (!viewport.IsValidCamera())
        return Error{"The view cannot be drawn: its camera has no valid location, direction or "
                     "up. Set the camera again."};

    FrameSetup frame = makeFrameSetup(scene, viewport, mode, width, height);
    image.resize(width, height);
    // Pixels are written as whole 32-bit words; the storage is aligned for them.
    frame.pixels = reinterpret_cast<std::uint32_t*>(image.rgba.data());
    const bool has_lines = LineDrawing::hasLines(scene, mode);
    const bool hides_lines = has_lines && frame.scene && !mode.shows_hidden_lines;
    DepthImage* const depth_used = depth ? depth : (hides_lines ? &m_depth : nullptr);
    if (depth_used) {
        depth_used->resize(width, height);
        depth_used->parallel = frame.rays.parallel;
        depth_used->reference_depth = frame.rays.far_depth - frame.rays.setback;
        frame.nearness = depth_used->nearness.data();
    }
    if (has_lines && frame.layers.count > 1) {
        m_layers.assign(
            static_cast<std::size_t>(width) * static_cast<std::size_t>(height) * layers_kept, 0.0F);
        frame.layer_nearness = m_layers.data();
    }
    const float* const layers = frame.layer_nearness;
    drawSurfaces(frame, mode);
    if (has_lines)
        m_lines.draw(scene, frame.rays, mode,
                     {frame.pixels, width, height, hides_lines ? depth_used : nullptr,
                      frame.rays.pixel_size, layers});
    return {};
}

void DisplayPipeline::drawSurfaces(FrameSetup& frame, const DisplayModeAttributes& mode) {
    const int level = std::clamp(mode.antialiasing_level, 0, 2);
    const bool smooths = level > 0 && frame.scene;
    if (smooths) {
        m_objects.resize(static_cast<std::size_t>(frame.width) *
                         static_cast<std::size_t>(frame.height));
        frame.objects = m_objects.data();
    }
    if (frame.scene && frame.sky_reach > 0.0F)
        m_free_sky.find(frame, *m_kernel);
    traceAll(frame, *m_kernel);
    frame.layer_nearness = nullptr; // the rays that smooth edges look beside the pixels' middles
    m_smoothed = 0;
    if (!smooths)
        return;
    m_edges.refine(frame, *m_kernel, level == 1 ? 4 : 8);
    m_smoothed = m_edges.count();
}

} // namespace quarn
