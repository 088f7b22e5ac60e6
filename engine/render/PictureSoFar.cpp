#include "engine/render/PictureSoFar.h"

#include "engine/render/RenderEncoding.h"
#include "engine/render/RenderLayers.h"
#include "engine/render/RenderLines.h"

#include <tbb/parallel_for.h>

#include <algorithm>

namespace quarn {

namespace {

using namespace std::chrono_literals;

constexpr auto least_pause = 500ms;
constexpr int pauses_of_its_own_time = 50;

} // namespace

PictureSoFar::PictureSoFar(const RenderLayers& layers, const FrameSetup& frame, RenderLines& lines,
                           const Renderer::Shown& shown)
    : m_layers(layers), m_frame(frame), m_lines(lines), m_shown(shown),
      m_due(Clock::now() + least_pause) {}

void PictureSoFar::showWhenDue() {
    const Clock::time_point start = Clock::now();
    if (!m_shown || start < m_due)
        return;
    encode();
    m_lines.draw(m_image);
    m_shown(m_image);
    const Clock::time_point end = Clock::now();
    m_due = end + std::max<Clock::duration>(least_pause, pauses_of_its_own_time * (end - start));
}

void PictureSoFar::encode() {
    m_image.resize(m_layers.width(), m_layers.height());
    tbb::parallel_for(0, m_layers.height(),
                      [&](int y) { encodeRow(m_layers, m_frame, y, m_image); });
}

} // namespace quarn
