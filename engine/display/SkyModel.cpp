#include "engine/display/SkyModel.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

LinearColor mix(const LinearColor& a, const LinearColor& b, float t) {
    return {a.r + t * (b.r - a.r), a.g + t * (b.g - a.g), a.b + t * (b.b - a.b)};
}

float smoothStep(float from, float to, float x) {
    const float t = std::clamp((x - from) / (to - from), 0.0F, 1.0F);
    return t * t * (3.0F - 2.0F * t);
}

KM_3dVector worldDirection(const CameraFrame& camera, const KM_3dVector& v) {
    const auto axis = [](const float* a) { return KM_3dVector(a[0], a[1], a[2]); };
    return v.x * axis(camera.x) + v.y * axis(camera.y) + v.z * axis(camera.z);
}

DirectionalLight lightFrom(KM_3dVector toward, const LinearColor& color, float shadow) {
    DirectionalLight light;
    if (!toward.Unitize())
        toward = KM_3dVector::ZAxis;
    light.toward[0] = static_cast<float>(toward.x);
    light.toward[1] = static_cast<float>(toward.y);
    light.toward[2] = static_cast<float>(toward.z);
    light.color = color;
    light.shadow = shadow;
    return light;
}

/// `above` reaches a surface that faces `up`, `below` one that faces the other way.
AmbientLight hemisphere(const LinearColor& above, const LinearColor& below, const float* up) {
    AmbientLight light;
    const float a[3] = {above.r, above.g, above.b};
    const float b[3] = {below.r, below.g, below.b};
    for (int c = 0; c < 3; ++c) {
        light.base[c] = 0.5F * (a[c] + b[c]);
        for (int axis = 0; axis < 3; ++axis)
            light.slope[c][axis] = 0.5F * (a[c] - b[c]) * up[axis];
    }
    return light;
}

/// The sky is brighter on the sun's side; this tells apart the walls that lie in shadow.
void brightenToward(AmbientLight& light, const float* toward, const LinearColor& by) {
    const float amount[3] = {by.r, by.g, by.b};
    for (int c = 0; c < 3; ++c) {
        light.slope[c][0] += amount[c] * toward[0];
        light.slope[c][1] += amount[c] * toward[1];
    }
}

constexpr float world_up[3] = {0.0F, 0.0F, 1.0F};

Sky daySky() {
    Sky sky;
    sky.horizon = {0.80F, 0.90F, 1.02F};
    sky.zenith = {0.19F, 0.41F, 0.80F};
    sky.nadir = {0.50F, 0.50F, 0.48F};
    sky.glow = {0.26F, 0.22F, 0.14F};
    sky.disc = {3.0F, 2.8F, 2.4F};
    return sky;
}

/// Around sunrise and sunset: warm where the sun stands, bluish across from it.
Sky duskSky() {
    Sky sky;
    sky.horizon = {0.62F, 0.45F, 0.40F};
    sky.side = {0.28F, 0.10F, -0.06F};
    sky.zenith = {0.12F, 0.20F, 0.40F};
    sky.nadir = {0.22F, 0.19F, 0.18F};
    sky.glow = {0.75F, 0.34F, 0.10F};
    sky.disc = {3.0F, 1.8F, 0.8F};
    return sky;
}

/// When the sun stands some six degrees below the horizon: blue, with a last band of warm light.
Sky twilightSky() {
    Sky sky;
    sky.horizon = {0.25F, 0.25F, 0.335F};
    sky.side = {0.20F, 0.08F, -0.02F};
    sky.zenith = {0.045F, 0.075F, 0.185F};
    sky.nadir = {0.085F, 0.085F, 0.105F};
    sky.glow = {0.30F, 0.13F, 0.03F};
    return sky;
}

Sky nightSky() {
    Sky sky;
    sky.horizon = {0.050F, 0.070F, 0.125F};
    sky.zenith = {0.010F, 0.016F, 0.045F};
    sky.nadir = {0.020F, 0.024F, 0.035F};
    return sky;
}

Sky blended(const Sky& a, const Sky& b, float t) {
    Sky sky;
    sky.horizon = mix(a.horizon, b.horizon, t);
    sky.side = mix(a.side, b.side, t);
    sky.zenith = mix(a.zenith, b.zenith, t);
    sky.nadir = mix(a.nadir, b.nadir, t);
    sky.glow = mix(a.glow, b.glow, t);
    sky.disc = mix(a.disc, b.disc, t);
    return sky;
}

/// A value at each time of the day.
template <class T> struct Times {
    T day;
    T dusk;
    T twilight;
    T night;
};

/// How much of day, dusk, twilight and night there is. `height` is the sine of the sun's altitude.
struct TimeOfDay {
    float day;
    float twilight;
    float night;
    explicit TimeOfDay(float height)
        : day(smoothStep(0.02F, 0.36F, height)), twilight(1.0F - smoothStep(-0.11F, 0.03F, height)),
          night(1.0F - smoothStep(-0.26F, -0.08F, height)) {}

    LinearColor among(const Times<LinearColor>& at) const {
        return mix(mix(mix(at.dusk, at.day, day), at.twilight, twilight), at.night, night);
    }
    Sky sky() const {
        const Sky above_horizon = blended(duskSky(), daySky(), day);
        return blended(blended(above_horizon, twilightSky(), twilight), nightSky(), night);
    }
};

AmbientLight skyLight(const TimeOfDay& time, const float* toward_sun) {
    const LinearColor above = time.among({{0.37F, 0.42F, 0.50F},
                                          {0.31F, 0.32F, 0.41F},
                                          {0.170F, 0.185F, 0.265F},
                                          {0.072F, 0.090F, 0.142F}});
    const LinearColor below = time.among({{0.26F, 0.225F, 0.185F},
                                          {0.15F, 0.13F, 0.12F},
                                          {0.075F, 0.070F, 0.080F},
                                          {0.028F, 0.033F, 0.052F}});
    const LinearColor sunward =
        time.among({{0.05F, 0.05F, 0.045F}, {0.10F, 0.06F, 0.03F}, {0.045F, 0.025F, 0.010F}, {}});
    AmbientLight light = hemisphere(above, below, world_up);
    brightenToward(light, toward_sun, sunward);
    return light;
}

DirectionalLight headLight(const CameraFrame& camera, const LinearColor& color) {
    return lightFrom(worldDirection(camera, {-0.25, 0.35, 1.0}), color, 0.0F);
}

LinearColor diffuseOf(const KM_Light& light) {
    return scaled(linearFromColor(light.Diffuse()), static_cast<float>(light.Intensity()));
}

/// What a sun sends: warmer and weaker near the horizon, nothing below it.
LinearColor sunColor(const KM_Light& light, float height) {
    const LinearColor tint =
        mix({0.95F, 0.52F, 0.24F}, {1.12F, 1.05F, 0.94F}, smoothStep(0.0F, 0.40F, height));
    const LinearColor own = scaled(diffuseOf(light), smoothStep(-0.015F, 0.06F, height));
    return {own.r * tint.r, own.g * tint.g, own.b * tint.b};
}

DirectionalLight sunOf(const KM_Light& light, bool casts_shadows, const CameraFrame& camera) {
    KM_3dVector toward = -light.Direction();
    if (light.Style() == KM_LightStyle::camera_directional)
        toward = worldDirection(camera, toward);
    const float shadow = casts_shadows ? static_cast<float>(light.ShadowIntensity()) : 0.0F;
    DirectionalLight sun = lightFrom(toward, diffuseOf(light), shadow);
    if (light.Style() == KM_LightStyle::world_directional)
        sun.color = sunColor(light, sun.toward[2]);
    return sun;
}

bool isLit(const DirectionalLight& light) {
    return light.color.r > 0.0F || light.color.g > 0.0F || light.color.b > 0.0F;
}

/// A wide soft light straight above, as studios have it, in step with the sky: without it metal
/// would mirror little but the blue of the zenith.
SoftBox overheadBox(const Sky& sky) {
    SoftBox box;
    box.half_width_deg = 34.0F;
    box.half_height_deg = 34.0F;
    box.border = 0.5F;
    box.color = scaled({1.0F, 0.985F, 0.96F}, 2.0F * brightnessOf(sky.horizon));
    return box;
}

Lighting lightingWithoutSun(const CameraFrame& camera) {
    Lighting lighting;
    lighting.sky = daySky();
    lighting.boxes.push_back(overheadBox(lighting.sky));
    lighting.sky.glow = {};
    lighting.sky.disc = {};
    lighting.ambient = hemisphere({0.62F, 0.65F, 0.70F}, {0.23F, 0.22F, 0.21F}, world_up);
    lighting.fixed.push_back(headLight(camera, {0.50F, 0.49F, 0.47F}));
    return lighting;
}

/// What metal mirrors of the neutral studio: pale above, dark below.
Sky roomAround() {
    Sky room;
    room.horizon = {0.50F, 0.505F, 0.52F};
    room.zenith = {0.88F, 0.89F, 0.91F};
    room.nadir = {0.16F, 0.16F, 0.165F};
    return room;
}

} // namespace

Lighting studioLighting(const CameraFrame& camera) {
    Lighting lighting;
    lighting.sky = roomAround();
    lighting.boxes.push_back(overheadBox(lighting.sky));
    lighting.ambient = hemisphere({0.46F, 0.47F, 0.49F}, {0.24F, 0.24F, 0.25F}, camera.y);
    lighting.fixed.push_back(
        lightFrom(worldDirection(camera, {-0.50, 0.62, 0.80}), {0.58F, 0.57F, 0.55F}, 0.0F));
    lighting.fixed.push_back(
        lightFrom(worldDirection(camera, {0.85, -0.05, 0.55}), {0.22F, 0.225F, 0.24F}, 0.0F));
    return lighting;
}

std::vector<DirectionalLight> documentSuns(std::span<const KM_Light> lights, bool casts_shadows,
                                           const CameraFrame& camera) {
    std::vector<DirectionalLight> suns;
    for (const KM_Light& light : lights)
        if (light.IsEnabled() && light.IsDirectionalLight())
            suns.push_back(sunOf(light, casts_shadows, camera));
    return suns;
}

Lighting skyLighting(std::span<const KM_Light> lights, bool casts_shadows,
                     const CameraFrame& camera) {
    const auto suns = documentSuns(lights, casts_shadows, camera);
    if (suns.empty())
        return lightingWithoutSun(camera);

    Lighting lighting;
    const float* toward = suns.front().toward;
    const TimeOfDay time(toward[2]);
    lighting.sky = time.sky();
    std::copy_n(toward, 3, lighting.sky.toward_sun);
    lighting.boxes.push_back(overheadBox(lighting.sky));
    lighting.ambient = skyLight(time, toward);
    lighting.fixed.push_back(headLight(camera, time.among({{0.04F, 0.04F, 0.04F},
                                                           {0.06F, 0.06F, 0.06F},
                                                           {0.085F, 0.088F, 0.100F},
                                                           {0.105F, 0.118F, 0.150F}})));
    std::copy_if(suns.begin(), suns.end(), std::back_inserter(lighting.suns), isLit);
    return lighting;
}

} // namespace quarn
