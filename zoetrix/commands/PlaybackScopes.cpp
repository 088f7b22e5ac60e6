#include "zoetrix/commands/PlaybackScopes.h"

#include "zoetrix/paths/ZoetrixDynamicAccess.h"

namespace {

void SwitchSun(CQuarnSun& sun, bool on) {
    sun.BeginChange(CQuarnSun::change_by_program);
    sun.SetEnabled(on);
    sun.EndChange();
}

KM_UUID DisplayModeOf(const CQuarnView& view) {
    const CDisplayPipelineAttributes* attributes = view.DisplayAttributes();
    return attributes ? attributes->Id() : KM_nil_uuid;
}

} // namespace

HiddenPaths::~HiddenPaths() {
    if (!m_shows_again)
        return;
    for (const CQuarnObjRef& path : m_hidden) {
        if (path.Object())
            m_doc.ShowObject(path, false);
    }
    m_doc.Regen();
}

void HiddenPaths::Hide(const KM_SimpleArray<KM_UUID>& curves) {
    for (const KM_UUID& id : curves) {
        const CQuarnObjRef path(id);
        m_hidden.push_back(path);
        if (!path.Object() || !m_doc.HideObject(path, false))
            m_hidden.pop_back();
    }
}

SavedDisplayMode::SavedDisplayMode(CQuarnView& view, bool restores)
    : m_view(view), m_mode_id(DisplayModeOf(view)), m_restores(restores) {}

SavedDisplayMode::~SavedDisplayMode() {
    if (m_restores)
        m_view.Viewport().SetDisplayMode(m_mode_id);
}

SavedCamera::SavedCamera(CQuarnViewport& viewport, bool restores)
    : m_viewport(viewport), m_saved(viewport.VP()), m_restores(restores) {}

SavedCamera::~SavedCamera() {
    if (!m_restores)
        return;
    m_viewport.SetVP(m_saved, true, true);
    // The horizon is not levelled here: a camera that was rolled comes back rolled.
    m_viewport.SetTargetAndCameraLocation(m_saved.TargetPoint(), m_saved.CameraLocation(), true,
                                          false);
}

SunSwitchedOff::SunSwitchedOff(CQuarnDoc& doc) : m_sun(doc.Sun()), m_was_on(m_sun.IsEnabled()) {
    if (m_was_on)
        SwitchSun(m_sun, false);
}

SunSwitchedOff::~SunSwitchedOff() {
    if (m_was_on)
        SwitchSun(m_sun, true);
}

StudyLight::~StudyLight() {
    const int index = m_props.LightIndex();
    CQuarnLightTable& lights = m_doc.LightTable();
    if (index < 0 || lights[index].IsDeleted())
        return;
    lights.DeleteLight(index, true);
    m_props.SetLightIndex(-1);
}

void StudyLight::Shine(const KM_3dPoint& from, const KM_3dPoint& to) {
    KM_Light light;
    light.SetStyle(KM_LightStyle::world_directional);
    light.SetLocation(from);
    light.SetDirection(to - from);
    ReplaceLight(m_doc, m_props, light);
}
