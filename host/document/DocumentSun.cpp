#include "host/document/DocumentSun.h"

#include "host/border/Contract.h"

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

using quarn::mayCallDocument;

bool CQuarnSun::IsEnabled() const {
    return mayCallDocument(*m_sun, "CQuarnSun::IsEnabled") && m_sun->isEnabled();
}

void CQuarnSun::BeginChange(int) {
    if (mayCallDocument(*m_sun, "CQuarnSun::BeginChange"))
        m_sun->beginChange();
}

void CQuarnSun::SetEnabled(bool enabled) {
    if (mayCallDocument(*m_sun, "CQuarnSun::SetEnabled"))
        m_sun->setEnabled(enabled);
}

bool CQuarnSun::EndChange() {
    return mayCallDocument(*m_sun, "CQuarnSun::EndChange") && m_sun->endChange();
}

KM_3dVector CQuarnSun::DirectionToSun() const {
    const bool allowed = mayCallDocument(*m_sun, "CQuarnSun::DirectionToSun");
    return allowed ? m_sun->directionToSun() : KM_3dVector::ZAxis;
}
