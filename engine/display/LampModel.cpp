#include "engine/display/LampModel.h"

#include "engine/display/SkyModel.h"

#include <algorithm>
#include <array>

namespace quarn {

namespace {

/// Nearer to a lamp than this part of the box's diagonal its light is not counted as more.
constexpr double NEAREST_OF_DIAGONAL = 0.02;

constexpr int PLACES_A_SIDE = 3;
constexpr int PLACES = PLACES_A_SIDE * PLACES_A_SIDE * PLACES_A_SIDE;

bool isLamp(const KM_Light& light) {
    switch (light.Style()) {
    case KM_LightStyle::world_point:
    case KM_LightStyle::world_spot:
    case KM_LightStyle::camera_point:
    case KM_LightStyle::camera_spot:
        return light.IsEnabled() && light.Intensity() > 0.0 && light.Location().IsValid();
    default:
        return false;
    }
}

KM_3dVector fromCamera(const CameraFrame& camera, const KM_3dVector& v) {
    const auto axis = [](const float* a) { return KM_3dVector(a[0], a[1], a[2]); };
    return v.x * axis(camera.x) + v.y * axis(camera.y) + v.z * axis(camera.z);
}

Lamp lampOf(const KM_Light& light, const CameraFrame& camera, const KM_3dPoint& eye) {
    Lamp lamp;
    lamp.place = light.Location();
    lamp.axis = light.Direction();
    const bool goes_along =
        light.Style() == KM_LightStyle::camera_point || light.Style() == KM_LightStyle::camera_spot;
    if (goes_along) {
        lamp.place = eye + fromCamera(camera, light.Location() - KM_3dPoint::Origin);
        lamp.axis = fromCamera(camera, light.Direction());
    }
    lamp.is_spot = (light.Style() == KM_LightStyle::world_spot ||
                    light.Style() == KM_LightStyle::camera_spot) &&
                   lamp.axis.Unitize();
    const LinearColor color = linearFromColor(light.Diffuse());
    const auto intensity = static_cast<float>(light.Intensity());
    lamp.color = {intensity * color.r, intensity * color.g, intensity * color.b};
    lamp.shadow = static_cast<float>(light.ShadowIntensity());
    return lamp;
}

/// The median, over places in the box, of what lamps send; weight(lamp) is each one's part.
template <class Weight>
double medianLight(std::span<const Lamp> lamps, const KM_BoundingBox& box, const Weight& weight) {
    const KM_3dVector sides = box.Diagonal();
    const double nearest = NEAREST_OF_DIAGONAL * sides.Length();
    std::array<double, PLACES> light{};
    for (int i = 0; i < PLACES; ++i) {
        const auto part = [](int index) { return (index + 0.5) / PLACES_A_SIDE; };
        const KM_3dPoint place =
            box.m_min + KM_3dVector(part(i % PLACES_A_SIDE) * sides.x,
                                    part(i / PLACES_A_SIDE % PLACES_A_SIDE) * sides.y,
                                    part(i / PLACES_A_SIDE / PLACES_A_SIDE) * sides.z);
        for (const Lamp& lamp : lamps) {
            const double distance = std::max(place.DistanceTo(lamp.place), nearest);
            if (distance > 0.0)
                light[static_cast<std::size_t>(i)] += weight(lamp) / (distance * distance);
        }
    }
    const auto median = light.begin() + PLACES / 2;
    std::nth_element(light.begin(), median, light.end());
    return *median;
}

} // namespace

std::vector<Lamp> lampsOf(std::span<const KM_Light> lights, const KM_BoundingBox& box,
                          const CameraFrame& camera, const KM_3dPoint& eye) {
    std::vector<Lamp> lamps;
    if (!box.IsValid())
        return lamps;
    for (const KM_Light& light : lights)
        if (isLamp(light))
            lamps.push_back(lampOf(light, camera, eye));
    const double median = medianLight(lamps, box, [](const Lamp&) { return 1.0; });
    if (!(median > 0.0))
        return {};
    const auto scale = static_cast<float>(1.0 / median);
    for (Lamp& lamp : lamps)
        lamp.color = {scale * lamp.color.r, scale * lamp.color.g, scale * lamp.color.b};
    return lamps;
}

float lightOfLamps(std::span<const Lamp> lamps, const KM_BoundingBox& box) {
    if (lamps.empty())
        return 0.0F;
    return static_cast<float>(
        medianLight(lamps, box, [](const Lamp& lamp) { return double{brightnessOf(lamp.color)}; }));
}

} // namespace quarn
