#pragma once

#include "engine/images/Image.h"
#include "engine/render/Renderer.h"

#include <chrono>

namespace quarn {

class RenderLayers;
class RenderLines;
struct FrameSetup;

/// Shows a picture now and then while its samples are taken: as it is, with its noise, because to
/// smooth it would take longer than to go on. What is not begun is grey.
class PictureSoFar {
public:
    /// @param frame  tells of the background
    /// @param shown  takes the picture; may be empty
    PictureSoFar(const RenderLayers& layers, const FrameSetup& frame, RenderLines& lines,
                 const Renderer::Shown& shown);

    /// Shows the picture when it is due: twice a second at most, and so seldom that this takes no
    /// more than a fiftieth of the time.
    void showWhenDue();

private:
    using Clock = std::chrono::steady_clock;

    void encode();

    const RenderLayers& m_layers;
    const FrameSetup& m_frame;
    RenderLines& m_lines;
    const Renderer::Shown& m_shown;
    Clock::time_point m_due;
    Image m_image;
};

} // namespace quarn
