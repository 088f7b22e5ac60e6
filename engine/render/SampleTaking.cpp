#include "engine/render/SampleTaking.h"

#include "engine/display/FlushDenormals.h"
#include "engine/render/RenderLayers.h"
#include "engine/render/TileStopping.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <bit>
#include <chrono>

namespace quarn {

namespace {

/// Pixels of a task's block, and samples that are taken of each at a time.
constexpr int block_width = 64;
constexpr int block_height = 32;
constexpr int samples_at_once = 32;

constexpr double batch_seconds = 0.05;

/// With fewer a tile is not stopped: thin things would be missed. A look at a picture of few
/// samples is to be quick.
int leastSamples(int samples) {
    return samples <= 8 ? 4 : 8;
}

int columnsOf(const RenderLayers& layers) {
    return (layers.width() + block_width - 1) / block_width;
}

} // namespace

SampleTaking::SampleTaking(const RenderSetup& setup, const RenderKernel& kernel,
                           RenderLayers& layers, int samples)
    : m_setup(setup), m_kernel(kernel), m_layers(layers), m_samples(samples),
      m_columns(columnsOf(layers)),
      m_blocks(m_columns * ((layers.height() + block_height - 1) / block_height)) {}

/// 4, 8, 12, 16, 24, 32, 48, 64 and so on: the tiles that need no more are looked for after a
/// half more at the most.
int SampleTaking::passEnd(int first, bool grows_evenly) const {
    const auto octave = static_cast<int>(std::bit_floor(static_cast<unsigned>(std::max(first, 8))));
    const int step = std::min(octave / 2, samples_at_once);
    const int wanted = grows_evenly && first == 0 ? 1 : (first / step + 1) * step;
    return std::min(m_samples, wanted);
}

RenderEnd SampleTaking::run(bool grows_evenly, const Pause& pause) {
    TileStopping stopping(m_layers, m_samples);
    for (int first = 0; first < m_samples;) {
        const int end = passEnd(first, grows_evenly);
        for (int finished = 0; finished < m_blocks;) {
            const double taken = first + double(end - first) * finished / m_blocks;
            if (!pause(taken / m_samples))
                return RenderEnd::cancelled;
            const int next = std::min(m_blocks, finished + m_batch);
            timed([&] { renderBlocks(finished, next, first, end); });
            finished = next;
        }
        first = end;
        if (first >= leastSamples(m_samples) && first < m_samples && !stopping.stopGoodTiles())
            break;
    }
    return RenderEnd::done;
}

template <class Work> void SampleTaking::timed(const Work& work) {
    const auto start = std::chrono::steady_clock::now();
    work();
    const std::chrono::duration<double> taken = std::chrono::steady_clock::now() - start;
    if (taken.count() < 0.5 * batch_seconds)
        m_batch = std::min(2 * m_batch, m_blocks); // small pictures never last that long
    else if (taken.count() > 2.0 * batch_seconds && m_batch > 4)
        m_batch /= 2;
}

void SampleTaking::renderBlocks(int begin, int end, int first_sample, int end_sample) {
    const RenderSums sums = m_layers.sums();
    tbb::parallel_for(begin, end, [&](int index) {
        const FlushDenormals flush;
        const int x = index % m_columns * block_width;
        const int y = index / m_columns * block_height;
        m_kernel.render_block(m_setup,
                              {x, y, std::min(m_layers.width(), x + block_width),
                               std::min(m_layers.height(), y + block_height)},
                              first_sample, end_sample, sums);
    });
}

} // namespace quarn
