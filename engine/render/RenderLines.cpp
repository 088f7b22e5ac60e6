#include "engine/render/RenderLines.h"

#include "engine/display/DisplayMode.h"
#include "engine/display/FlushDenormals.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <vector>

namespace quarn {

namespace {

constexpr int rows_at_once = 32;

/// The frame without its light: the colours that the ray loops find are not needed.
FrameSetup unlit(FrameSetup frame) {
    frame.fixed_count = 0;
    frame.sun_count = 0;
    frame.has_ground = false;
    frame.has_sky = false;
    frame.textures = false;
    return frame;
}

void findDepth(FrameSetup frame, DepthImage& depth) {
    depth.resize(frame.width, frame.height);
    depth.parallel = frame.rays.parallel;
    depth.reference_depth = frame.rays.far_depth - frame.rays.setback;
    std::vector<std::uint32_t> colors(depth.nearness.size());
    frame.pixels = colors.data();
    frame.nearness = depth.nearness.data();
    const RayKernel& kernel = rayKernelInForce();
    const int count = (frame.height + rows_at_once - 1) / rows_at_once;
    tbb::parallel_for(0, count, [&](int index) {
        const FlushDenormals flush;
        const int y = index * rows_at_once;
        kernel.trace_block(frame, {0, y, frame.width, std::min(frame.height, y + rows_at_once)});
    });
}

} // namespace

RenderLines::RenderLines(const DisplayScene& scene, const FrameSetup& frame, bool is_seen)
    : m_scene(scene), m_rays(frame.rays),
      m_has_lines(is_seen && LineDrawing::hasLines(scene, *findDisplayMode(rendered_mode_id))),
      m_has_surfaces(frame.scene != nullptr) {
    if (m_has_lines && m_has_surfaces)
        findDepth(unlit(frame), m_depth);
}

void RenderLines::draw(Image& image) {
    if (!m_has_lines)
        return;
    LineTarget target;
    // Pixels are written as whole 32-bit words; the storage is aligned for them.
    target.pixels = reinterpret_cast<std::uint32_t*>(image.rgba.data());
    target.width = image.width;
    target.height = image.height;
    target.depth = m_has_surfaces ? &m_depth : nullptr;
    target.pixel_size = m_rays.pixel_size;
    m_drawing.draw(m_scene, m_rays, *findDisplayMode(rendered_mode_id), target);
}

} // namespace quarn
