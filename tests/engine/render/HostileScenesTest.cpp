#include "engine/display/LinePick.h"
#include "engine/display/RayPick.h"
#include "tests/engine/display/HostileNumbers.h"
#include "tests/engine/render/RenderFixture.h"

namespace quarn {
namespace {

constexpr unsigned scenes = 400;

void expectDrawn(const DisplayScene& scene, const KM_Viewport& camera, DisplayPipeline& pipeline) {
    Image image;
    for (const DisplayModeAttributes& mode : standardDisplayModes()) {
        EXPECT_TRUE(pipeline.draw(scene, camera, mode, 26, 18, image).ok());
        EXPECT_EQ(image.rgba.size(), 26U * 18U * 4U);
    }
    RenderRequest request;
    request.width_px = 14;
    request.height_px = 10;
    request.samples = 2;
    const auto end = Renderer().render(
        scene, camera, request, [](double) { return true; }, image);
    EXPECT_TRUE(end.ok());
}

void pick(const SceneContent& content, const DisplayScene& scene, KM_Viewport camera) {
    PickRay ray;
    ray.is_parallel = camera.IsParallelProjection();
    camera.SetScreenPort(26, 18);
    if (camera.GetRay(13.0, 9.0, ray.origin, ray.direction))
        firstSurface(scene, ray);
    const LinePick lines(camera, 13.0, 9.0);
    for (const SceneCurve& curve : scene.curves())
        lines.nearest({curve.polyline.Array(), static_cast<std::size_t>(curve.polyline.Count())});
    EXPECT_EQ(scene.meshes().size(), content.meshes.size());
}

TEST(HostileScenes, AnyNumberInAnySceneIsDrawnRenderedAndPickedFromWithoutHarm) {
    DisplayPipeline pipeline;
    for (unsigned seed = 0; seed < scenes; ++seed) {
        SCOPED_TRACE(seed);
        HostileNumbers numbers(seed);
        const SceneContent content = numbers.scene();
        DisplayScene scene;
        ASSERT_TRUE(scene.update(content).ok());
        for (int i = 0; i < 2; ++i) {
            const KM_Viewport camera = numbers.camera();
            expectDrawn(scene, camera, pipeline);
            pick(content, scene, camera);
        }
    }
}

TEST(HostileScenes, TheRendererShowsTheBackgroundToACameraOutOfRange) {
    SceneContent content;
    addMesh(content, boxMesh({-1.0, -1.0, -1.0}, {1.0, 1.0, 1.0}));
    content.points.push_back({KM_CreateUuid(), KM_3dPoint::Origin});
    content.lights.push_back(sunLight({0.4, 0.5, -0.7}));
    SceneContent nothing;
    nothing.lights = content.lights;
    KM_Viewport camera = perspectiveView(KM_3dPoint::Origin, {0.0, 1.0, 0.0});
    RenderRequest request;
    request.width_px = 24;
    request.height_px = 16;
    request.samples = 4;
    const Image background = rendered(nothing, camera, request);
    for (const double far : {1.01e13, 1e19, 1e300}) {
        camera.SetCameraLocation({far, 0.0, 0.0});
        EXPECT_TRUE(rendered(content, camera, request).rgba == background.rgba) << far;
    }
}

TEST(HostileScenes, ASmallObjectBesideAVeryFarOneIsRendered) {
    SceneContent content;
    addMesh(content, boxMesh({-0.5, -0.5, -0.5}, {0.5, 0.5, 0.5}));
    addMesh(content, boxMesh({-0.5, 7e9, -0.5}, {0.5, 7.1e9, 0.5}));
    RenderRequest request;
    request.width_px = 24;
    request.height_px = 16;
    request.samples = 4;
    const Image image = rendered(content, perspectiveView({2.0, -3.0, 2.0}, {}), request);
    EXPECT_GT(meanBrightness(image), 5.0);
}

} // namespace
} // namespace quarn
