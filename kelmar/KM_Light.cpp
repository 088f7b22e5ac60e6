#include "kelmar/KM_Light.h"

#include <algorithm>

void KM_Light::SetStyle(int style) {
    const bool known = (style >= static_cast<int>(KM_LightStyle::camera_directional) &&
                        style <= static_cast<int>(KM_LightStyle::ambient));
    m_style = known ? static_cast<KM_LightStyle>(style) : KM_LightStyle::unknown;
}

bool KM_Light::IsDirectionalLight() const {
    return m_style == KM_LightStyle::camera_directional ||
           m_style == KM_LightStyle::world_directional;
}

void KM_Light::SetIntensity(double intensity) {
    m_intensity = KM_IsValid(intensity) ? std::max(intensity, 0.0) : 0.0;
}

void KM_Light::SetShadowIntensity(double intensity) {
    m_shadow_intensity = KM_IsValid(intensity) ? std::clamp(intensity, 0.0, 1.0) : 0.0;
}
