#pragma once

#include "engine/render/RenderLayers.h"
#include "engine/render/RenderSetupBuilder.h"
#include "engine/render/Renderer.h"
#include "engine/render/SampleSequence.h"
#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

namespace quarn {

/// Renders a picture; `kernel` null takes the best one.
inline Image rendered(const SceneContent& content, const KM_Viewport& viewport,
                      const RenderRequest& request, const RenderKernel* kernel = nullptr) {
    DisplayScene scene;
    const Result<void> updated = scene.update(content);
    EXPECT_TRUE(updated.ok()) << updated.message();
    const Renderer renderer = kernel ? Renderer(*kernel) : Renderer();
    Image image;
    const auto end = renderer.render(
        scene, viewport, request, [](double) { return true; }, image);
    EXPECT_TRUE(end.ok() && end.value() == RenderEnd::done);
    return image;
}

/// Adds a mesh of see-through material, as opaque as its colour says; gives back its index.
inline std::size_t addPane(SceneContent& content, KM_Mesh mesh, KM_Color color) {
    const std::size_t index = addMesh(content, std::move(mesh), color);
    auto material = std::make_shared<Material>(*content.meshes[index].placed.material);
    material->see_through = true;
    content.meshes[index].placed.material = material;
    return index;
}

/// The sums of a scene in even light of brightness 1 from all sides, with no other light and no
/// ground.
inline RenderLayers inEvenLight(const SceneContent& content, const KM_Viewport& viewport,
                                int size_px, int samples) {
    DisplayScene scene;
    const Result<void> updated = scene.update(content);
    EXPECT_TRUE(updated.ok()) << updated.message();
    const SampleSequence sequence(samples);
    const RenderKernel& kernel = renderKernelInForce();
    RenderTables tables;
    RenderSetup setup =
        makeRenderSetup(scene, viewport, size_px, size_px, sequence, kernel, tables);
    setup.environment = {};
    for (FrameSetup* frame : {&setup.frame, &setup.bounce}) {
        frame->sun_count = 0;
        frame->fixed_count = 0;
        frame->soft_box_count = 0;
        frame->has_ground = false;
        for (int c = 0; c < 3; ++c) {
            frame->sky_horizon[c] = frame->sky_zenith[c] = frame->sky_nadir[c] = 1.0F;
            frame->sky_side[c] = frame->sky_glow[c] = frame->sky_disc[c] = 0.0F;
            setup.sky_scale[c] = 1.0F;
        }
    }
    RenderLayers layers(size_px, size_px);
    kernel.render_block(setup, {0, 0, size_px, size_px}, 0, samples, layers.sums());
    return layers;
}

/// All light of a pixel in a channel, 0 for red.
inline double lightAt(const RenderLayers& layers, int channel, int x, int y) {
    double light = 0.0;
    for (const int plane :
         {RenderPlane::direct_r, RenderPlane::sky_r, RenderPlane::sun_r, RenderPlane::gloss_r})
        light += double{layers.at(plane + channel, x, y)};
    return light / double{layers.at(RenderPlane::samples, x, y)};
}

/// The part of the sky's light that reached a pixel's surfaces, 0 to 1.
inline double skyVisible(const RenderLayers& layers, int x, int y) {
    return double{layers.at(RenderPlane::sky_g, x, y)} /
           double{layers.at(RenderPlane::albedo_g, x, y)};
}

} // namespace quarn
