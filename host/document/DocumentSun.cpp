#include "host/document/DocumentSun.h"

namespace quarn {

void DocumentSun::beginChange() {
    m_at_change_begin.push_back(m_state);
}

void DocumentSun::setEnabled(bool enabled) {
    if (!m_at_change_begin.empty())
        m_state.enabled = enabled;
}

void DocumentSun::setDirectionToSun(const KM_3dVector& direction_to_sun) {
    KM_3dVector direction = direction_to_sun;
    if (!m_at_change_begin.empty() && direction.Unitize())
        m_state.direction_to_sun = direction;
}

bool DocumentSun::endChange() {
    if (m_at_change_begin.empty())
        return false;
    const bool changed = m_state != m_at_change_begin.back();
    m_at_change_begin.pop_back();
    return changed;
}

std::optional<KM_Light> DocumentSun::light() const {
    if (!m_state.enabled)
        return std::nullopt;
    KM_Light light;
    light.SetStyle(KM_LightStyle::world_directional);
    light.SetLocation(KM_3dPoint(m_state.direction_to_sun));
    light.SetDirection(-m_state.direction_to_sun);
    return light;
}

} // namespace quarn

bool CQuarnSun::IsEnabled() const {
    return m_sun->isEnabled();
}

void CQuarnSun::BeginChange(int) {
    m_sun->beginChange();
}

void CQuarnSun::SetEnabled(bool enabled) {
    m_sun->setEnabled(enabled);
}

bool CQuarnSun::EndChange() {
    return m_sun->endChange();
}

KM_3dVector CQuarnSun::DirectionToSun() const {
    return m_sun->directionToSun();
}
