#include "engine/render/Renderer.h"

#include "engine/display/DisplayPipeline.h"
#include "engine/display/DisplayScene.h"
#include "engine/render/LightFilter.h"
#include "engine/render/PictureSoFar.h"
#include "engine/render/RenderEncoding.h"
#include "engine/render/RenderLayers.h"
#include "engine/render/RenderLines.h"
#include "engine/render/RenderSetupBuilder.h"
#include "engine/render/SampleSequence.h"
#include "engine/render/SampleTaking.h"
#include "ground/FreeMemory.h"
#include "kelmar/KM_Viewport.h"

#include <string>

namespace quarn {

namespace {

constexpr std::size_t bytes_per_pixel = RenderLayers::bytes_per_pixel +
                                        LightFilter::bytes_per_pixel + render_encoding_bytes +
                                        RenderLines::bytes_per_pixel + 8;

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
    if (request.samples < 1 || request.samples > RenderRequest::most_samples)
        return Error{"A picture cannot be rendered with " + std::to_string(request.samples) +
                     " samples: their number must be from 1 to " +
                     std::to_string(RenderRequest::most_samples) + "."};
    if (!viewport.IsValidCamera())
        return Error{"The view cannot be rendered: its camera has no valid location, direction or "
                     "up. Set the camera again."};
    return {};
}

} // namespace

Renderer::Renderer() : m_kernel(&renderKernelInForce()) {}

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
                                   const RenderRequest& request, const Watch& watch, Image& image,
                                   const Shown& shown) const {
    if (const auto checked = checkRequest(request, viewport); !checked)
        return checked.error();
    if (const auto checked = checkMemory(request, freeMemory()); !checked)
        return checked.error();
    const SampleSequence sequence(request.samples);
    RenderTables tables;
    const RenderSetup setup = makeRenderSetup(scene, viewport, request.width_px, request.height_px,
                                              sequence, *m_kernel, tables);
    RenderLines lines(scene, setup.frame,
                      scene.canBeSeenBy(viewport, request.width_px, request.height_px));
    RenderLayers layers(request.width_px, request.height_px);
    SampleTaking taking(setup, *m_kernel, layers, request.samples);
    PictureSoFar so_far(layers, setup.frame, lines, shown);
    const auto pause = [&](double share) {
        so_far.showWhenDue();
        return watch(share);
    };
    if (taking.run(static_cast<bool>(shown), pause) == RenderEnd::cancelled)
        return RenderEnd::cancelled;
    LightFilter filter(layers, setup.frame.rays.parallel ? setup.frame.scene_size : 0.0F,
                       *m_kernel);
    encodeRender(layers, setup.frame, filter, image);
    lines.draw(image);
    return RenderEnd::done;
}

} // namespace quarn
