#include "host/render/Renderer.h"

#include "host/display/DisplayPipeline.h"
#include "host/display/DisplayScene.h"
#include "host/display/FlushDenormals.h"
#include "host/render/FreeMemory.h"
#include "host/render/LightFilter.h"
#include "host/render/RenderEncoding.h"
#include "host/render/RenderLayers.h"
#include "host/render/RenderSettings.h"
#include "host/render/RenderSetupBuilder.h"
#include "host/render/SampleSequence.h"
#include "kelmar/KM_Viewport.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <chrono>
#include <string>

namespace quarn {

namespace {

/// Pixels of a task's block, and samples that are taken of each at a time.
constexpr int block_width = 64;
constexpr int block_height = 32;
constexpr int samples_at_once = 32;

constexpr std::size_t bytes_per_pixel =
    RenderLayers::bytes_per_pixel + LightFilter::bytes_per_pixel + render_encoding_bytes + 4;

bool isSide(int side_px) {
    return side_px >= 1 && side_px <= DisplayPipeline::max_size_px;
}

std::string sizeText(const RenderRequest& request) {
    return "A picture of " + std::to_string(request.width_px) + " by " +
           std::to_string(request.height_px) + " pixels";
}

Result<void> checkRequest(const RenderRequest& request, const KM_Viewport& viewport) {
    if (!isSide(request.width_px) || !isSide(request.height_px))
        return Error{sizeText(request) + " cannot be rendered: each side must be from 1 to " +
                     std::to_string(DisplayPipeline::max_size_px) + "."};
    if (request.samples < 1 || request.samples > RenderSettings::most_samples)
        return Error{"A picture cannot be rendered with " + std::to_string(request.samples) +
                     " samples: their number must be from 1 to " +
                     std::to_string(RenderSettings::most_samples) + "."};
    if (!viewport.IsValidCamera())
        return Error{"The view cannot be rendered: its camera has no valid location, direction or "
                     "up. Set the camera again."};
    return {};
}

/// Takes all samples, as many blocks at a time as last for some hundredths of a second.
class SampleTaking {
public:
    SampleTaking(const RenderSetup& setup, const RenderKernel& kernel, RenderLayers& layers,
                 int samples)
        : m_setup(setup), m_kernel(kernel), m_sums(layers.sums()), m_width(layers.width()),
          m_height(layers.height()), m_samples(samples),
          m_columns((m_width + block_width - 1) / block_width),
          m_blocks(m_columns * ((m_height + block_height - 1) / block_height)) {}

    RenderEnd run(const Renderer::Watch& watch) {
        for (int first = 0; first < m_samples; first += samples_at_once) {
            const int end = std::min(m_samples, first + samples_at_once);
            for (int block = 0; block < m_blocks;) {
                const double taken = first + double(end - first) * block / m_blocks;
                if (!watch(taken / m_samples))
                    return RenderEnd::cancelled;
                const int next = std::min(m_blocks, block + m_batch);
                timed([&] { renderBlocks(block, next, first, end); });
                block = next;
            }
        }
        return RenderEnd::done;
    }

private:
    static constexpr double batch_seconds = 0.05;

    template <class Work> void timed(const Work& work) {
        const auto start = std::chrono::steady_clock::now();
        work();
        const std::chrono::duration<double> taken = std::chrono::steady_clock::now() - start;
        if (taken.count() < 0.5 * batch_seconds)
            m_batch = std::min(2 * m_batch, m_blocks); // small pictures never last that long
        else if (taken.count() > 2.0 * batch_seconds && m_batch > 4)
            m_batch /= 2;
    }

    void renderBlocks(int begin, int end, int first_sample, int end_sample) {
        tbb::parallel_for(begin, end, [&](int index) {
            const FlushDenormals flush;
            const int x = index % m_columns * block_width;
            const int y = index / m_columns * block_height;
            m_kernel.render_block(
                m_setup,
                {x, y, std::min(m_width, x + block_width), std::min(m_height, y + block_height)},
                first_sample, end_sample, m_sums);
        });
    }

    const RenderSetup& m_setup;
    const RenderKernel& m_kernel;
    const RenderSums m_sums;
    const int m_width;
    const int m_height;
    const int m_samples;
    const int m_columns;
    const int m_blocks;
    int m_batch = 4;
};

} // namespace

Renderer::Renderer() : m_kernel(&bestRenderKernel()) {}

Result<void> Renderer::checkMemory(const RenderRequest& request, std::uint64_t available) {
    const std::uint64_t wanted = std::uint64_t{bytes_per_pixel} *
                                 static_cast<std::uint64_t>(request.width_px) *
                                 static_cast<std::uint64_t>(request.height_px);
    if (wanted <= available)
        return {};
    constexpr std::uint64_t megabyte = 1000000;
    return Error{sizeText(request) + " takes " + std::to_string(wanted / megabyte + 1) +
                 " MB of memory to render, and " + std::to_string(available / megabyte) +
                 " MB are free. Close other programs, or choose a smaller size with "
                 "RenderSettings."};
}

Result<RenderEnd> Renderer::render(const DisplayScene& scene, const KM_Viewport& viewport,
                                   const RenderRequest& request, const Watch& watch,
                                   Image& image) const {
    if (const auto checked = checkRequest(request, viewport); !checked)
        return checked.error();
    if (const auto checked = checkMemory(request, freeMemory()); !checked)
        return checked.error();
    const SampleSequence sequence(request.samples);
    const RenderSetup setup =
        makeRenderSetup(scene, viewport, request.width_px, request.height_px, sequence, *m_kernel);
    RenderLayers layers(request.width_px, request.height_px);
    if (SampleTaking(setup, *m_kernel, layers, request.samples).run(watch) == RenderEnd::cancelled)
        return RenderEnd::cancelled;
    LightFilter filter(layers, request.samples,
                       setup.frame.rays.parallel ? setup.frame.scene_size : 0.0F, *m_kernel);
    encodeRender(layers, request.samples, filter, image);
    return RenderEnd::done;
}

} // namespace quarn
