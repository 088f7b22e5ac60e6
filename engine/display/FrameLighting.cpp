#include "engine/display/FrameLighting.h"

#include "engine/display/AmbientFromAround.h"
#include "engine/display/DisplayMode.h"
#include "engine/display/DisplayScene.h"
#include "engine/display/PictureLight.h"
#include "engine/display/SceneLighting.h"
#include "engine/display/StudioModel.h"
#include "engine/images/ColorSpace.h"
#include "kelmar/KM_Viewport.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace quarn {

namespace {

/// How far surfaces of clay hide the sky from each other.
constexpr float SKY_REACH_OF_CLAY = 0.09F;
/// How high the middle of what mirrors the ground lies over it, beside the ground's reach.
constexpr float GROUND_EYE_OF_REACH = 0.1F;
/// Lamps are taken to be of this size, as a part of the scene's: nearer by they shine no brighter.
constexpr float LAMP_OF_SCENE = 0.002F;

float radians(float degrees) {
    return degrees * std::numbers::pi_v<float> / 180.0F;
}

void setVector(float (&to)[3], const KM_3dVector& v) {
    to[0] = static_cast<float>(v.x);
    to[1] = static_cast<float>(v.y);
    to[2] = static_cast<float>(v.z);
}

FrameLight frameLight(const DirectionalLight& light) {
    FrameLight result{};
    std::copy_n(light.toward, 3, result.toward);
    setChannels(result.color, light.color);
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

FrameSoftBox frameSoftBox(const SoftBox& box) {
    FrameSoftBox result{};
    std::copy_n(box.toward, 3, result.toward);
    const KM_3dVector toward(box.toward[0], box.toward[1], box.toward[2]);
    KM_3dVector across = KM_CrossProduct(KM_3dVector::ZAxis, toward);
    if (!across.Unitize())
        across = KM_3dVector::XAxis;
    setVector(result.across, across);
    setVector(result.along, KM_CrossProduct(toward, across));
    result.half_width = std::tan(radians(box.half_width_deg));
    result.half_height = std::tan(radians(box.half_height_deg));
    result.border = box.border;
    setChannels(result.color, box.color);
    return result;
}

void setSoftBoxes(FrameSetup& frame, const std::vector<SoftBox>& boxes) {
    frame.soft_box_count = static_cast<int>(std::min(boxes.size(), std::size(frame.soft_boxes)));
    for (int i = 0; i < frame.soft_box_count; ++i)
        frame.soft_boxes[i] = frameSoftBox(boxes[static_cast<std::size_t>(i)]);
}

FrameLamp frameLamp(const Lamp& lamp, const KM_3dPoint& origin, float size) {
    FrameLamp result{};
    setVector(result.place, lamp.place - origin);
    setChannels(result.color, lamp.color);
    setVector(result.axis, lamp.axis);
    const float outer = std::cos(radians(SPOT_OUTER_DEG));
    result.cone_slope = lamp.is_spot ? 1.0F / (std::cos(radians(SPOT_INNER_DEG)) - outer) : 0.0F;
    result.cone_base = lamp.is_spot ? -outer * result.cone_slope : 1.0F;
    result.least_square = std::max(size * size, 1e-30F);
    result.shadow = lamp.shadow;
    return result;
}

/// The brightest ones, where there are too many.
void setLamps(FrameSetup& frame, std::vector<Lamp> lamps, const DisplayScene& scene) {
    std::ranges::stable_sort(lamps, [](const Lamp& a, const Lamp& b) {
        return brightnessOf(a.color) > brightnessOf(b.color);
    });
    const auto size = LAMP_OF_SCENE * static_cast<float>(scene.wholeBox().Diagonal().Length());
    frame.lamp_count = static_cast<int>(std::min(lamps.size(), std::size(frame.lamps)));
    for (int i = 0; i < frame.lamp_count; ++i)
        frame.lamps[i] = frameLamp(lamps[static_cast<std::size_t>(i)], scene.origin(), size);
}

void setSky(FrameSetup& frame, const Lighting& lighting) {
    setChannels(frame.sky_horizon, lighting.sky.horizon);
    setChannels(frame.sky_side, lighting.sky.side);
    setChannels(frame.sky_zenith, lighting.sky.zenith);
    setChannels(frame.sky_nadir, lighting.sky.nadir);
    setChannels(frame.sky_glow, lighting.sky.glow);
    // In a parallel view all rays look the same way: the disc would fill the picture.
    if (!frame.rays.parallel)
        setChannels(frame.sky_disc, lighting.sky.disc);
    std::copy_n(lighting.sky.toward_sun, 3, frame.toward_sun);
}

void setLights(FrameSetup& frame, const Lighting& lighting, const DisplayScene& scene) {
    std::copy_n(lighting.ambient.base, 3, frame.ambient_base);
    for (int c = 0; c < 3; ++c)
        std::copy_n(lighting.ambient.slope[c], 3, frame.ambient_slope[c]);
    frame.exposure = lighting.exposure;
    frame.fixed_count = setLights(lighting.fixed, frame.fixed);
    frame.sun_count = setLights(lighting.suns, frame.suns);
    setLamps(frame, lighting.lamps, scene);
    setSky(frame, lighting);
    setSoftBoxes(frame, lighting.boxes);
    if (lighting.picture)
        frame.picture = {lighting.picture->sharp(), lighting.picture->broad(),
                         lighting.picture_scale};
}

/// The ground lies under the lowest point. Rays look for it only where they met no surface, so it
/// never flickers through a floor of the model's own.
void placeGround(FrameSetup& frame) {
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
    frame.ground_eye = GROUND_EYE_OF_REACH * frame.ground_fade_start;
    setChannels(frame.ground_albedo, {0.49F, 0.48F, 0.455F});
    // Far ground lies in the haze of the horizon, so that both meet without a line.
    std::copy_n(frame.sky_horizon, 3, frame.sky_nadir);
}

/// What open ground sends to mirrors.
void setGroundLight(FrameSetup& frame) {
    for (int c = 0; c < 3; ++c) {
        float light = frame.ambient_base[c] + frame.ambient_slope[c][2];
        for (int k = 0; k < frame.sun_count; ++k)
            light += frame.suns[k].color[c] * std::max(frame.suns[k].toward[2], 0.0F);
        frame.ground_light[c] = frame.ground_albedo[c] * light;
    }
}

void setGradient(FrameSetup& frame, const KM_Color& top, const KM_Color& bottom, float exposure) {
    const auto setEnd = [exposure](float(&light)[3], float(&shown)[3], const KM_Color& color) {
        setChannels(light, sceneLightShownAs(color));
        setChannels(shown, linearFromColor(color));
        if (exposure == 1.0F)
            return;
        for (int c = 0; c < 3; ++c) {
            light[c] *= exposure;
            shown[c] = toneMapped(light[c]);
        }
    };
    setEnd(frame.background_top, frame.shown_top, top);
    setEnd(frame.background_bottom, frame.shown_bottom, bottom);
}

void setBackground(FrameSetup& frame, const LightSettings& settings,
                   const DisplayModeAttributes& mode, Surroundings surroundings) {
    const BackgroundKind kind = settings.background;
    frame.has_clear_background = kind == BackgroundKind::transparent;
    frame.has_sky =
        kind == BackgroundKind::automatic && mode.has_sky && surroundings != Surroundings::studio;
    frame.catches_shadows = frame.has_ground && (kind != BackgroundKind::automatic ||
                                                 surroundings != Surroundings::sky ||
                                                 mode.surface_style == SurfaceStyle::studio);
    if (kind == BackgroundKind::color)
        setGradient(frame, settings.background_color, settings.background_color, 1.0F);
    else if (surroundings == Surroundings::studio)
        setGradient(frame, STUDIO_BACKDROP_TOP, STUDIO_BACKDROP_BOTTOM, frame.exposure);
    else
        setGradient(frame, mode.background_top, mode.background_bottom, 1.0F);
}

} // namespace

void setLighting(FrameSetup& frame, const DisplayScene& scene, const KM_Viewport& viewport,
                 const DisplayModeAttributes& mode) {
    const CameraFrame camera{frame.rays.camera_x, frame.rays.camera_y, frame.rays.camera_z};
    const Surroundings surroundings = surroundingsIn(scene, mode);
    setLights(frame, lightingOf(scene, mode, camera, viewport.CameraLocation()), scene);
    if (mode.has_ground_plane && scene.light().has_ground && frame.scene)
        placeGround(frame);
    if (mode.surface_style == SurfaceStyle::clay) {
        frame.sky_reach = SKY_REACH_OF_CLAY * frame.scene_size;
        setChannels(frame.ground_albedo, {0.72F, 0.72F, 0.72F});
    }
    if (surroundings == Surroundings::studio)
        setChannels(frame.ground_albedo,
                    {STUDIO_FLOOR_ALBEDO, STUDIO_FLOOR_ALBEDO, STUDIO_FLOOR_ALBEDO});
    setBackground(frame, scene.light(), mode, surroundings);
    if (mode.surface_style == SurfaceStyle::studio)
        std::copy_n(frame.background_bottom, 3, frame.ground_light);
    else if (surroundings == Surroundings::sky)
        setGroundLight(frame);
    else
        setAmbientFromAround(frame);
}

} // namespace quarn
