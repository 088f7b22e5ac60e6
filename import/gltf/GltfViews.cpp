#include "import/gltf/GltfViews.h"

#include "import/assembly/StoredColor.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace quarn::gltf {

namespace {

KM_wString nameOf(const Json& node, const Json& thing) {
    const std::string name = text(member(node, "name"));
    return KM_wString::FromUtf8(name.empty() ? text(member(thing, "name")) : name);
}

void readOpening(const Json& camera, SourceCamera& read) {
    const Json& parallel = member(camera, "orthographic");
    if (!parallel.is_null()) {
        const double half_width = number(member(parallel, "xmag"), 0.0);
        const double half_height = number(member(parallel, "ymag"), 0.0);
        read.is_parallel = true;
        if (half_width > 0.0)
            read.half_width = half_width;
        if (half_width > 0.0 && half_height > 0.0)
            read.aspect = std::clamp(half_width / half_height, 0.01, 100.0);
        return;
    }
    const Json& perspective = member(camera, "perspective");
    const double aspect = number(member(perspective, "aspectRatio"), 0.0);
    read.aspect = aspect > 0.01 && aspect < 100.0 ? aspect : read.aspect;
    const double half_angle = 0.5 * number(member(perspective, "yfov"), 0.0);
    if (half_angle > 0.01 && half_angle < 1.5)
        read.half_width = std::tan(half_angle) * read.aspect;
}

KM_LightStyle styleOf(const std::string& type) {
    if (type == "directional")
        return KM_LightStyle::world_directional;
    return type == "spot" ? KM_LightStyle::world_spot : KM_LightStyle::world_point;
}

} // namespace

std::optional<SourceCamera> cameraOf(const Json& json, const Json& node,
                                     const KM_Xform& world_from_node) {
    const auto index = wholeNumber(member(node, "camera"));
    const Json& camera = element(member(json, "cameras"), index.value_or(UINT64_MAX));
    if (camera.is_null())
        return std::nullopt;
    SourceCamera read;
    read.name = nameOf(node, camera);
    read.location = world_from_node * KM_3dPoint::Origin;
    read.direction = world_from_node * KM_3dVector(0.0, 0.0, -1.0);
    read.up = world_from_node * KM_3dVector(0.0, 1.0, 0.0);
    readOpening(camera, read);
    return read;
}

std::optional<KM_Light> lightOf(const Json& json, const Json& node,
                                const KM_Xform& world_from_node) {
    const auto index = wholeNumber(member(extension(node, "KHR_lights_punctual"), "light"));
    const Json& lights = member(extension(json, "KHR_lights_punctual"), "lights");
    const Json& light = element(lights, index.value_or(UINT64_MAX));
    if (light.is_null())
        return std::nullopt;
    std::array<double, 3> c{1.0, 1.0, 1.0};
    readNumbers(member(light, "color"), c);
    KM_Light read;
    read.SetStyle(styleOf(text(member(light, "type"))));
    read.SetLightName(nameOf(node, light));
    read.SetLocation(world_from_node * KM_3dPoint::Origin);
    read.SetDirection(world_from_node * KM_3dVector(0.0, 0.0, -1.0));
    read.SetDiffuse(colorFromLinear(static_cast<float>(c[0]), static_cast<float>(c[1]),
                                    static_cast<float>(c[2]), 1.0F));
    read.SetIntensity(std::max(0.0, number(member(light, "intensity"), 1.0)));
    return read;
}

void normalizeIntensities(std::vector<KM_Light>& lights) {
    for (const bool is_lux : {false, true}) {
        double most = 0.0;
        for (const KM_Light& light : lights)
            if (light.IsDirectionalLight() == is_lux)
                most = std::max(most, light.Intensity());
        for (KM_Light& light : lights)
            if (light.IsDirectionalLight() == is_lux && most > 0.0)
                light.SetIntensity(light.Intensity() / most);
    }
}

} // namespace quarn::gltf
