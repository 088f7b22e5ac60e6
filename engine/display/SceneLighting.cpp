#include "engine/display/SceneLighting.h"

#include "engine/display/DisplayMode.h"
#include "engine/display/DisplayScene.h"
#include "engine/display/LightChoice.h"
#include "engine/display/PictureLight.h"
#include "engine/display/StudioModel.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// The light on a white surface that pictures of the surroundings are brought to.
constexpr float LIGHT_OF_PICTURES = 0.8F;
/// How much a picture's sun counts for that: half of all surfaces face it, more or less.
constexpr float PART_OF_SUN = 0.5F;
constexpr float LAMPS_UNDER_SKY = 0.5F;
/// Of the lights of Shaded that go with the camera, in the studio: whatever side it looks at, the
/// faces of a model are told apart.
constexpr float LIGHT_AT_CAMERA = 0.6F;
/// More would end the range of numbers.
constexpr double MOST_STOPS = 30.0;

/// Light without colour, more of it from the sky and less from the suns, so that shadows are soft:
/// a model of plaster in a room with large windows.
Lighting clayLighting(Lighting lighting) {
    constexpr float sky = 1.62F;
    constexpr float sun = 0.45F;
    AmbientLight& ambient = lighting.ambient;
    const float base = brightnessOf({ambient.base[0], ambient.base[1], ambient.base[2]});
    float slope[3];
    for (int i = 0; i < 3; ++i)
        slope[i] = brightnessOf({ambient.slope[0][i], ambient.slope[1][i], ambient.slope[2][i]});
    for (int c = 0; c < 3; ++c) {
        ambient.base[c] = sky * base;
        for (int i = 0; i < 3; ++i)
            ambient.slope[c][i] = sky * slope[i];
    }
    for (auto* const lights : {&lighting.fixed, &lighting.suns})
        for (DirectionalLight& light : *lights) {
            const float white = sun * brightnessOf(light.color);
            light.color = {white, white, white};
        }
    return lighting;
}

/// Paper is of the background's colour and gives it back from everywhere.
Lighting paperLighting(const KM_Color& paper) {
    Lighting lighting;
    const LinearColor light = sceneLightShownAs(paper);
    lighting.ambient.base[0] = light.r;
    lighting.ambient.base[1] = light.g;
    lighting.ambient.base[2] = light.b;
    return lighting;
}

Lighting pictureLighting(const PictureLight& picture, bool casts_shadows) {
    Lighting lighting;
    DirectionalLight sun;
    sun.color = {picture.sunColor()[0], picture.sunColor()[1], picture.sunColor()[2]};
    const float light = picture.meanLight() + PART_OF_SUN * brightnessOf(sun.color);
    lighting.picture = &picture;
    lighting.picture_scale = light > 0.0F ? LIGHT_OF_PICTURES / light : 1.0F;
    if (!picture.hasSun())
        return lighting;
    std::copy_n(picture.towardSun(), 3, sun.toward);
    sun.color = scaled(sun.color, lighting.picture_scale);
    sun.shadow = casts_shadows ? 1.0F : 0.0F;
    lighting.suns.push_back(sun);
    return lighting;
}

Lighting lightingAmong(Surroundings surroundings, const DisplayScene& scene, bool casts_shadows,
                       const CameraFrame& camera) {
    if (surroundings == Surroundings::sky)
        return skyLighting(scene.lights(), casts_shadows, camera);
    if (surroundings == Surroundings::picture)
        return pictureLighting(*scene.pictureLight(), casts_shadows);
    Lighting lighting = productStudio();
    for (DirectionalLight light : studioLighting(camera).fixed) {
        light.color = scaled(light.color, LIGHT_AT_CAMERA);
        lighting.fixed.push_back(light);
    }
    return lighting;
}

/// What suns send to open ground.
float lightOfSuns(const std::vector<DirectionalLight>& suns) {
    float light = 0.0F;
    for (const DirectionalLight& sun : suns)
        light += brightnessOf(sun.color) * std::max(sun.toward[2], 0.0F);
    return light;
}

/// Lets the model's own lights shine, where there is no sky for them.
void addOwnLights(Lighting& lighting, const DisplayScene& scene, bool casts_shadows,
                  const CameraFrame& camera) {
    const std::size_t of_sky = scene.light().first_light_is_sun && !scene.lights().empty() ? 1 : 0;
    const auto suns = documentSuns(scene.lights().subspan(of_sky), casts_shadows, camera);
    lighting.exposure /= 1.0F + lightOfSuns(suns) + lightOfLamps(lighting.lamps, scene.wholeBox());
    lighting.suns.insert(lighting.suns.end(), suns.begin(), suns.end());
}

void expose(Lighting& lighting) {
    const float by = lighting.exposure;
    for (int c = 0; c < 3; ++c) {
        lighting.ambient.base[c] *= by;
        for (float& slope : lighting.ambient.slope[c])
            slope *= by;
    }
    for (auto* const lights : {&lighting.fixed, &lighting.suns})
        for (DirectionalLight& light : *lights)
            light.color = scaled(light.color, by);
    Sky& sky = lighting.sky;
    for (LinearColor* const color :
         {&sky.horizon, &sky.side, &sky.zenith, &sky.nadir, &sky.glow, &sky.disc})
        *color = scaled(*color, by);
    for (SoftBox& box : lighting.boxes)
        box.color = scaled(box.color, by);
    for (Lamp& lamp : lighting.lamps)
        lamp.color = scaled(lamp.color, by);
    lighting.picture_scale *= by;
}

float factorOf(const std::optional<double>& stops) {
    if (!stops || std::isnan(*stops))
        return 1.0F;
    return static_cast<float>(std::exp2(std::clamp(*stops, -MOST_STOPS, MOST_STOPS)));
}

Lighting documentLighting(const DisplayScene& scene, bool casts_shadows, const CameraFrame& camera,
                          const KM_3dPoint& eye) {
    const Surroundings surroundings = scene.surroundings();
    Lighting lighting = lightingAmong(surroundings, scene, casts_shadows, camera);
    lighting.lamps = lampsOf(scene.lights(), scene.wholeBox(), camera, eye);
    if (surroundings == Surroundings::sky) {
        for (Lamp& lamp : lighting.lamps)
            lamp.color = scaled(lamp.color, LAMPS_UNDER_SKY);
    } else {
        addOwnLights(lighting, scene, casts_shadows, camera);
    }
    for (Lamp& lamp : lighting.lamps)
        lamp.shadow = casts_shadows ? lamp.shadow : 0.0F;
    lighting.exposure *= factorOf(scene.light().exposure);
    if (lighting.exposure != 1.0F)
        expose(lighting);
    return lighting;
}

} // namespace

Lighting lightingOf(const DisplayScene& scene, const DisplayModeAttributes& mode,
                    const CameraFrame& camera, const KM_3dPoint& eye) {
    if (mode.surface_style == SurfaceStyle::paper)
        return paperLighting(scene.light().background == BackgroundKind::color
                                 ? scene.light().background_color
                                 : mode.background_top);
    if (mode.uses_document_lights && mode.surface_style == SurfaceStyle::clay)
        return clayLighting(skyLighting(scene.lights(), mode.casts_shadows, camera));
    if (mode.uses_document_lights)
        return documentLighting(scene, mode.casts_shadows, camera, eye);
    return studioLighting(camera);
}

Surroundings surroundingsIn(const DisplayScene& scene, const DisplayModeAttributes& mode) {
    const bool is_lit = mode.uses_document_lights && mode.surface_style == SurfaceStyle::lit;
    return is_lit ? scene.surroundings() : Surroundings::sky;
}

} // namespace quarn
