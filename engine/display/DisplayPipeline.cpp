#include "engine/display/DisplayPipeline.h"

#include "engine/display/DisplayScene.h"
#include "engine/display/FlushDenormals.h"
#include "engine/display/FrameSetupBuilder.h"
#include "kelmar/KM_Viewport.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <string>

namespace quarn {

namespace {

/// Pixels of a task's block; neighbouring rays share what they read of the scene.
constexpr int block_width = PixelMarks::block_width;
constexpr int block_height = 32;

/// Shadows on the ground of a mode to work with are found again with every change of the model.
constexpr int directions_to_work_with = 64;

/// After so many pictures of less than a quarter of the pixels the buffers of a large one go.
constexpr int small_pictures_to_let_go = 64;

bool isValidSize(int size) {
    return size >= 1 && size <= DisplayPipeline::max_size_px;
}

/// The blocks of a picture, in rows.
class BlockGrid {
public:
    explicit BlockGrid(const FrameSetup& frame)
        : m_width(frame.width), m_height(frame.height),
          m_columns((frame.width + block_width - 1) / block_width),
          m_rows((frame.height + block_height - 1) / block_height) {}

    std::size_t count() const {
        return static_cast<std::size_t>(m_columns) * static_cast<std::size_t>(m_rows);
    }
    /// Calls work(block, index) for all blocks, on all threads.
    template <class Work> void forEach(const Work& work) const {
        tbb::parallel_for(0, m_columns * m_rows, [&](int index) {
            const FlushDenormals flush;
            const int x = index % m_columns * block_width;
            const int y = index / m_columns * block_height;
            work(PixelBlock{x, y, std::min(m_width, x + block_width),
                            std::min(m_height, y + block_height)},
                 static_cast<std::size_t>(index));
        });
    }

private:
    int m_width;
    int m_height;
    int m_columns;
    int m_rows;
};

} // namespace

DisplayPipeline::DisplayPipeline() : m_kernel(&rayKernelInForce()) {}

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

    makeRoom(width, height);
    FrameSetup frame = makeFrameSetup(scene, viewport, mode, width, height);
    image.resize(width, height);
    // Pixels are written as whole 32-bit words; the storage is aligned for them.
    frame.pixels = reinterpret_cast<std::uint32_t*>(image.rgba.data());
    const bool has_lines =
        scene.canBeSeenBy(viewport, width, height) && LineDrawing::hasLines(scene, mode);
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
    if (frame.scene && frame.catches_shadows && frame.sky_reach <= 0.0F)
        m_open_ground.find(frame, *m_kernel, scene.surfacesNumber(),
                           mode.surface_style == SurfaceStyle::studio ? directions_to_work_with
                                                                      : ground_directions);
    drawSurfaces(frame, mode);
    if (has_lines)
        m_lines.draw(scene, frame.rays, mode,
                     {frame.pixels, width, height, hides_lines ? depth_used : nullptr,
                      frame.rays.pixel_size, layers});
    return {};
}

/// Views of several sizes are drawn by turns, so one small picture says nothing.
void DisplayPipeline::makeRoom(int width, int height) {
    const std::int64_t pixels = std::int64_t{width} * height;
    m_small_pictures = 4 * pixels < m_held_px ? m_small_pictures + 1 : 0;
    if (m_small_pictures >= small_pictures_to_let_go) {
        m_objects = std::vector<std::uint32_t>();
        m_depth = DepthImage();
        m_layers = std::vector<float>();
        m_marked = MarkedPixels();
        m_free_sky = FreeSky();
        m_lines = LineDrawing();
        m_held_px = 0;
        m_small_pictures = 0;
    }
    m_held_px = std::max(m_held_px, pixels);
}

void DisplayPipeline::drawSurfaces(FrameSetup& frame, const DisplayModeAttributes& mode) {
    const int level = std::clamp(mode.antialiasing_level, 0, 2);
    const bool smooths = level > 0 && frame.scene;
    if (smooths) {
        m_objects.resize(static_cast<std::size_t>(frame.width) *
                         static_cast<std::size_t>(frame.height));
        frame.objects = m_objects.data();
    }
    frame.needs_unit_faces = frame.sun_count > 0 || frame.sky_reach > 0.0F || frame.has_mirrors;
    if (frame.scene && frame.sky_reach > 0.0F)
        m_free_sky.find(frame, *m_kernel);
    if (frame.has_mirrors)
        m_environment.find(frame, *m_kernel);
    const BlockGrid blocks(frame);
    m_smoothed = 0;
    if (!smooths) {
        blocks.forEach(
            [&](const PixelBlock& block, std::size_t) { m_kernel->trace_block(frame, block); });
        return;
    }
    // The rays that smooth edges look beside the pixels' middles: the lines' layers stay out of it.
    FrameSetup again = frame;
    again.layer_nearness = nullptr;
    again.nearness = nullptr;
    m_marked.begin(frame, level == 1 ? 4 : 8, blocks.count());
    blocks.forEach([&](const PixelBlock& block, std::size_t index) {
        m_kernel->trace_block(frame, block);
        m_marked.refineInside(again, *m_kernel, block, index);
    });
    blocks.forEach([&](const PixelBlock& block, std::size_t) {
        m_marked.findAcross(again, *m_kernel, block);
    });
    blocks.forEach([&](const PixelBlock& block, std::size_t index) {
        m_marked.refineBorder(again, *m_kernel, block, index);
    });
    m_smoothed = m_marked.count();
}

} // namespace quarn
