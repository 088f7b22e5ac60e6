#include "host/document/LightStore.h"

#include "host/border/Contract.h"
#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>

namespace quarn {

namespace {

bool needsDirection(KM_LightStyle style) {
    return style != KM_LightStyle::camera_point && style != KM_LightStyle::world_point &&
           style != KM_LightStyle::ambient;
}

} // namespace

bool LightStore::canShine(const KM_Light& light) {
    if (light.Style() == KM_LightStyle::unknown || !light.Location().IsValid())
        return false;
    const KM_3dVector& direction = light.Direction();
    return !needsDirection(light.Style()) || (direction.IsValid() && !direction.IsZero());
}

CQuarnLight LightStore::deletedLight() {
    CQuarnLight light;
    light.m_deleted = true;
    return light;
}

const CQuarnLight& LightStore::at(int index) const {
    const auto found = m_live.find(index);
    return found == m_live.end() ? m_no_light : found->second;
}

int LightStore::add(const KM_Light& light) {
    if (!canShine(light) || m_slot_count >= most_slots)
        return no_index;
    m_live[m_slot_count].m_light = light;
    return m_slot_count++;
}

int LightStore::addOfPlugIn(const KM_Light& light) {
    const int index = add(light);
    m_last_of_plug_in = index;
    m_dark_of_plug_in = canShine(light) ? std::nullopt : std::optional(light);
    return index;
}

void LightStore::addDeletedUpTo(int count) {
    m_slot_count = std::max(m_slot_count, std::min(count, most_slots));
}

bool LightStore::remove(int index) {
    return m_live.erase(index) > 0;
}

std::vector<KM_Light> LightStore::shiningLights() const {
    std::vector<KM_Light> lights;
    for (const auto& [index, slot] : m_live)
        if (slot.Light().IsEnabled())
            lights.push_back(slot.Light());
    return lights;
}

std::optional<KM_Light> LightStore::studySun() const {
    const CQuarnLight& slot = at(m_last_of_plug_in);
    const KM_Light& light = m_dark_of_plug_in ? *m_dark_of_plug_in : slot.Light();
    const bool is_there = m_dark_of_plug_in || !slot.IsDeleted();
    const bool is_sun =
        is_there && light.IsEnabled() && light.Style() == KM_LightStyle::world_directional;
    return is_sun ? std::optional(light) : std::nullopt;
}

} // namespace quarn

using quarn::mayCallDocument;

int CQuarnLightTable::LightCount() const {
    return mayCallDocument(*m_lights, "CQuarnLightTable::LightCount") ? m_lights->count() : 0;
}

const CQuarnLight& CQuarnLightTable::operator[](int index) const {
    const bool allowed = mayCallDocument(*m_lights, "CQuarnLightTable::operator[]");
    return m_lights->at(allowed ? index : quarn::LightStore::no_index);
}

int CQuarnLightTable::AddLight(const KM_Light& light, const KM_3dmObjectAttributes*) {
    const bool allowed = mayCallDocument(*m_lights, "CQuarnLightTable::AddLight");
    return allowed ? m_lights->addOfPlugIn(light) : quarn::LightStore::no_index;
}

bool CQuarnLightTable::DeleteLight(int index, bool quiet) {
    if (!mayCallDocument(*m_lights, "CQuarnLightTable::DeleteLight"))
        return false;
    const bool deleted = m_lights->remove(index);
    if (!deleted && !quiet)
        QuarnApp().Print(KM_wString::FormatToString(
            QnLocalizeString(L"There is no light with the index %d\n", 42090), index));
    return deleted;
}
