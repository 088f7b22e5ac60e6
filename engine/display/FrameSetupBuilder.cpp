#include "engine/display/FrameSetupBuilder.h"

#include "engine/display/DisplayMode.h"
#include "engine/display/DisplayScene.h"
#include "engine/display/DisplayTable.h"
#include "engine/display/ShownLight.h"
#include "engine/display/SkyModel.h"
#include "engine/display/SplitSum.h"
#include "engine/images/ColorSpace.h"
#include "kelmar/KM_Viewport.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace quarn {

namespace {

/// How far surfaces of clay hide the sky from each other.
constexpr float sky_reach_of_scene = 0.09F;
/// How far things in the studio darken the ground.
constexpr float sky_reach_of_studio = 0.2F;
/// How high the middle of what mirrors the ground lies over it, beside the ground's reach.
constexpr float ground_eye_of_reach = 0.1F;

void set(float (&to)[3], const LinearColor& color) {
    to[0] = color.r;
    to[1] = color.g;
    to[2] = color.b;
}

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

FrameLight frameLight(const DirectionalLight& light) {
    FrameLight result{};
    std::copy_n(light.toward, 3, result.toward);
    set(result.color, light.color);
    result.shadow = light.shadow;
    return result;
}

template <std::size_t capacity>
int setLights(const std::vector<DirectionalLight>& lights, FrameLight (&to)[capacity]) {
    const std::size_t count = std::min(lights.size(), capacity);
    std::transform(lights.begin(), lights.begin() + static_cast<std::ptrdiff_t>(count), to,
                   frameLight);
    return static_cast<int>(count);
}

void setLighting(FrameSetup& frame, const Lighting& lighting) {
    std::copy_n(lighting.ambient.base, 3, frame.ambient_base);
    for (int c = 0; c < 3; ++c)
        std::copy_n(lighting.ambient.slope[c], 3, frame.ambient_slope[c]);
    frame.fixed_count = setLights(lighting.fixed, frame.fixed);
    frame.sun_count = setLights(lighting.suns, frame.suns);
    set(frame.sky_horizon, lighting.sky.horizon);
    set(frame.sky_side, lighting.sky.side);
    set(frame.sky_zenith, lighting.sky.zenith);
    set(frame.sky_nadir, lighting.sky.nadir);
    set(frame.sky_glow, lighting.sky.glow);
    // In a parallel view all rays look the same way: the disc would fill the picture.
    if (!frame.rays.parallel)
        set(frame.sky_disc, lighting.sky.disc);
    std::copy_n(lighting.sky.toward_sun, 3, frame.toward_sun);
}

FrameSoftBox frameSoftBox(const SoftBox& box) {
    FrameSoftBox result{};
    std::copy_n(box.toward, 3, result.toward);
    const KM_3dVector toward(box.toward[0], box.toward[1], box.toward[2]);
    KM_3dVector across = KM_CrossProduct(KM_3dVector::ZAxis, toward);
    if (!across.Unitize())
        across = KM_3dVector::XAxis;
    const KM_3dVector along = KM_CrossProduct(toward, across);
    setPoint(result.across, KM_3dPoint::Origin + across);
    setPoint(result.along, KM_3dPoint::Origin + along);
    const auto tangent = [](float degrees) {
        return std::tan(degrees * std::numbers::pi_v<float> / 180.0F);
    };
    result.half_width = tangent(box.half_width_deg);
    result.half_height = tangent(box.half_height_deg);
    result.border = box.border;
    set(result.color, box.color);
    return result;
}

/// What surfaces mirror beside the sky.
void setMirrored(FrameSetup& frame, const Lighting& lighting) {
    frame.split_sum = splitSum().entries();
    frame.soft_box_count =
        static_cast<int>(std::min(lighting.boxes.size(), std::size(frame.soft_boxes)));
    for (int i = 0; i < frame.soft_box_count; ++i)
        frame.soft_boxes[i] = frameSoftBox(lighting.boxes[static_cast<std::size_t>(i)]);
    frame.ground_eye = ground_eye_of_reach * frame.ground_fade_start;
    for (int c = 0; c < 3; ++c) {
        float light = frame.ambient_base[c] + frame.ambient_slope[c][2];
        for (int k = 0; k < frame.sun_count; ++k)
            light += frame.suns[k].color[c] * std::max(frame.suns[k].toward[2], 0.0F);
        frame.ground_light[c] = frame.ground_albedo[c] * light;
    }
}

/// The ground lies under the lowest point. Rays look for it only where they met no surface, so it
/// never flickers through a floor of the model's own.
void setGround(FrameSetup& frame) {
    if (!frame.scene)
        return;
    const float width = frame.scene_max[0] - frame.scene_min[0];
    const float depth = frame.scene_max[1] - frame.scene_min[1];
    const float height = frame.scene_max[2] - frame.scene_min[2];
    const float reach = std::max({width, depth, height});
    frame.has_ground = true;
    frame.ground_height = frame.scene_min[2] - 1e-5F * frame.scene_size;
    frame.ground_center[0] = 0.5F * (frame.scene_min[0] + frame.scene_max[0]);
    frame.ground_center[1] = 0.5F * (frame.scene_min[1] + frame.scene_max[1]);
    frame.ground_fade_start = 1.5F * reach; // far enough for the long shadows of a low sun
    frame.ground_fade_end = 12.0F * reach;
    // Far ground lies in the haze of the horizon, so that both meet without a line.
    std::copy_n(frame.sky_horizon, 3, frame.sky_nadir);
    set(frame.ground_albedo, {0.49F, 0.48F, 0.455F});
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
        set(frame.plain_albedo, {0.86F, 0.86F, 0.86F});
    if (style == SurfaceStyle::x_ray)
        set(frame.plain_albedo, {0.42F, 0.58F, 0.76F});
}

/// Light without colour, more of it from the sky and less from the suns, so that shadows are soft:
/// a model of plaster in a room with large windows.
Lighting clayLighting(Lighting lighting) {
    const auto grey = [](float r, float g, float b) {
        return 0.2126F * r + 0.7152F * g + 0.0722F * b; // luminance by ITU-R BT.709
    };
    constexpr float sky = 1.62F;
    constexpr float sun = 0.45F;
    AmbientLight& ambient = lighting.ambient;
    const float base = grey(ambient.base[0], ambient.base[1], ambient.base[2]);
    float slope[3];
    for (int i = 0; i < 3; ++i)
        slope[i] = grey(ambient.slope[0][i], ambient.slope[1][i], ambient.slope[2][i]);
    for (int c = 0; c < 3; ++c) {
        ambient.base[c] = sky * base;
        for (int i = 0; i < 3; ++i)
            ambient.slope[c][i] = sky * slope[i];
    }
    for (auto* const lights : {&lighting.fixed, &lighting.suns})
        for (DirectionalLight& light : *lights) {
            const float white = sun * grey(light.color.r, light.color.g, light.color.b);
            light.color = {white, white, white};
        }
    return lighting;
}

/// Paper gives back the background's colour from everywhere.
Lighting paperLighting(const KM_Color& paper) {
    Lighting lighting;
    const LinearColor light = sceneLightShownAs(paper);
    lighting.ambient.base[0] = light.r;
    lighting.ambient.base[1] = light.g;
    lighting.ambient.base[2] = light.b;
    return lighting;
}

Lighting lightingOf(const DisplayScene& scene, const DisplayModeAttributes& mode,
                    const CameraFrame& camera) {
    if (mode.surface_style == SurfaceStyle::paper)
        return paperLighting(mode.background_top);
    if (mode.uses_document_lights && mode.surface_style == SurfaceStyle::clay)
        return clayLighting(skyLighting(scene.lights(), mode.casts_shadows, camera));
    if (mode.uses_document_lights)
        return skyLighting(scene.lights(), mode.casts_shadows, camera);
    return studioLighting(camera);
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
    const CameraFrame camera{frame.rays.camera_x, frame.rays.camera_y, frame.rays.camera_z};
    const Lighting lighting = lightingOf(scene, mode, camera);
    setLighting(frame, lighting);
    if (mode.has_ground_plane)
        setGround(frame);
    if (mode.surface_style == SurfaceStyle::clay) {
        frame.sky_reach = sky_reach_of_scene * frame.scene_size;
        set(frame.ground_albedo, {0.72F, 0.72F, 0.72F});
    }
    if (mode.surface_style == SurfaceStyle::studio) {
        frame.sky_reach = sky_reach_of_studio * frame.scene_size;
        frame.hides_sky_of_ground_alone = true;
        set(frame.ground_albedo, {0.40F, 0.40F, 0.40F});
    }
    if (frame.has_mirrors)
        setMirrored(frame, lighting);
    frame.has_sky = mode.has_sky;
    set(frame.background_top, sceneLightShownAs(mode.background_top));
    set(frame.background_bottom, sceneLightShownAs(mode.background_bottom));
    frame.display_table = displayTable().entries();
    frame.shown_light = shownLight().entries();
    return frame;
}

} // namespace quarn
