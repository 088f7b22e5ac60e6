#pragma once

#include "kelmar/KM_Light.h"

namespace quarn {

/// The properties of a light, open to be written and read.
struct LightFields {
    LightFields() : LightFields(KM_Light()) {}
    explicit LightFields(const KM_Light& light)
        : style(light.Style()), location(light.Location()), direction(light.Direction()),
          intensity(light.Intensity()), shadow_intensity(light.ShadowIntensity()),
          diffuse(light.Diffuse()), enabled(light.IsEnabled()), id(light.LightId()),
          name(light.LightName()) {}

    KM_Light light() const {
        KM_Light light;
        light.SetStyle(static_cast<int>(style));
        light.SetLocation(location);
        light.SetDirection(direction);
        light.SetIntensity(intensity);
        light.SetShadowIntensity(shadow_intensity);
        light.SetDiffuse(diffuse);
        light.Enable(enabled);
        light.SetLightId(id);
        light.SetLightName(name);
        return light;
    }

    KM_LightStyle style;
    KM_3dPoint location;
    KM_3dVector direction;
    double intensity;
    double shadow_intensity;
    KM_Color diffuse;
    bool enabled;
    KM_UUID id;
    KM_wString name;
};

/// The layout of a light, for a FieldWriter or a FieldReader.
template <class Step, class AnyFields> bool lightFields(Step step, AnyFields& light) {
    return step(light.style, KM_LightStyle::unknown, KM_LightStyle::ambient) &&
           step(light.location) && step(light.direction) && step(light.intensity) &&
           step(light.shadow_intensity) && step(light.diffuse) && step(light.enabled) &&
           step(light.id) && step(light.name);
}

} // namespace quarn
