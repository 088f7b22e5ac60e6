#pragma once

#include "engine/display/LineDrawing.h"
#include "engine/display/kernel/FrameSetup.h"
#include "engine/images/Image.h"

#include <cstddef>

namespace quarn {

class DisplayScene;

/// The curves and points of a rendered picture: they look as in Rendered mode, and surfaces hide
/// them.
class RenderLines {
public:
    /// Looks how near the surfaces of a picture are, where there are lines.
    /// @param scene    must stay as it is
    /// @param frame    of the same scene
    /// @param is_seen  false: the picture shows the background alone
    RenderLines(const DisplayScene& scene, const FrameSetup& frame, bool is_seen);

    /// Draws the lines over a picture of the frame's size.
    void draw(Image& image);

    /// Bytes that a pixel takes at most.
    static constexpr std::size_t bytes_per_pixel = sizeof(float) + sizeof(std::uint32_t);

private:
    const DisplayScene& m_scene;
    CameraRays m_rays;
    bool m_has_lines;
    bool m_has_surfaces;
    DepthImage m_depth;
    LineDrawing m_drawing;
};

} // namespace quarn
