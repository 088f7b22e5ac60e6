#include "engine/display/FrameSetupBuilder.h"

#include "engine/display/DisplayMode.h"
#include "engine/display/DisplayScene.h"
#include "engine/display/DisplayTable.h"
#include "engine/display/FrameLighting.h"
#include "engine/display/ShownLight.h"
#include "engine/display/SplitSum.h"
#include "engine/images/ColorSpace.h"
#include "kelmar/KM_Viewport.h"

#include <algorithm>

namespace quarn {

namespace {

void setPoint(float (&to)[3], const KM_3dPoint& point) {
    to[0] = static_cast<float>(point.x);
    to[1] = static_cast<float>(point.y);
    to[2] = static_cast<float>(point.z);
}

void setScene(FrameSetup& frame, const DisplayScene& scene) {
    frame.scene = scene.rays().root();
    frame.sole_first_surface = static_cast<std::int32_t>(scene.rays().soleFirstSurface());
    if (scene.rays().hasInstances())
        frame.first_surfaces = scene.rays().firstSurfaces().data();
    frame.surfaces = scene.rays().surfaces().data();
    const KM_BoundingBox& box = scene.surfaceBox();
    if (!box.IsValid())
        return;
    const KM_3dVector from_world = KM_3dPoint::Origin - scene.origin();
    setPoint(frame.scene_min, box.m_min + from_world);
    setPoint(frame.scene_max, box.m_max + from_world);
    frame.scene_size = static_cast<float>(box.Diagonal().Length());
}

/// The camera's rays in the coordinates of the scene.
CameraRays raysIn(const DisplayScene& scene, const KM_Viewport& viewport, int width, int height) {
    if (scene.origin() == KM_3dPoint::Origin)
        return cameraRays(viewport, width, height, scene.boundingBox());
    const KM_3dVector from_world = KM_3dPoint::Origin - scene.origin();
    KM_Viewport moved = viewport;
    moved.SetCameraLocationLock(false); // a person's lock is about the world
    moved.SetCameraLocation(viewport.CameraLocation() + from_world);
    KM_BoundingBox box;
    for (int i = 0; i < 8 && scene.boundingBox().IsValid(); ++i)
        box.Set(scene.boundingBox().Corner(i) + from_world);
    return cameraRays(moved, width, height, box);
}

/// Rays of a picture that shows the background alone: they look where the camera looks, with the
/// opening of a usual lens, from the origin.
CameraRays raysToBackground(const KM_Viewport& viewport, int width, int height) {
    KM_Viewport camera;
    camera.SetCameraLocation(KM_3dPoint::Origin);
    camera.SetCameraDirection(-viewport.CameraZ());
    camera.SetCameraUp(viewport.CameraY());
    return cameraRays(camera, width, height, KM_BoundingBox());
}

void setStyle(FrameSetup& frame, SurfaceStyle style, const RayScene& rays) {
    if (showsMaterials(style)) {
        frame.textures = true;
        frame.has_see_through = rays.hasSeeThrough();
        frame.has_looks = rays.hasLooks();
        frame.has_one_sided = rays.hasOneSided();
        frame.has_mirrors = rays.hasMirrors();
        frame.mirrors_scene = frame.has_mirrors && style == SurfaceStyle::lit;
    }
    if (style == SurfaceStyle::translucent)
        frame.layers = {12, 0.36F, 0.85F, 0.55F};
    if (style == SurfaceStyle::x_ray)
        frame.layers = {16, 0.10F, 0.75F, 0.12F};
    if (style == SurfaceStyle::clay || style == SurfaceStyle::x_ray || style == SurfaceStyle::paper)
        frame.base_colors = false;
    if (style == SurfaceStyle::clay)
        setChannels(frame.plain_albedo, {0.86F, 0.86F, 0.86F});
    if (style == SurfaceStyle::x_ray)
        setChannels(frame.plain_albedo, {0.42F, 0.58F, 0.76F});
}

} // namespace

FrameSetup makeFrameSetup(const DisplayScene& scene, const KM_Viewport& viewport,
                          const DisplayModeAttributes& mode, int width, int height) {
    FrameSetup frame;
    frame.width = width;
    frame.height = height;
    const bool is_seen = scene.canBeSeenBy(viewport, width, height);
    frame.rays = is_seen ? raysIn(scene, viewport, width, height)
                         : raysToBackground(viewport, width, height);
    if (is_seen && mode.surface_style != SurfaceStyle::none)
        setScene(frame, scene);
    setStyle(frame, mode.surface_style, scene.rays());
    setLighting(frame, scene, viewport, mode);
    if (frame.has_mirrors)
        frame.split_sum = splitSum().entries();
    frame.display_table = displayTable().entries();
    frame.shown_light = shownLight().entries();
    return frame;
}

} // namespace quarn
