#include "host/document/LightStore.h"

#include "host/app/Contract.h"
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
    if (index < 0 || index >= count())
        return m_no_light;
    return m_slots[static_cast<std::size_t>(index)];
}

int LightStore::add(const KM_Light& light) {
    if (!canShine(light))
        return no_index;
    m_slots.emplace_back().m_light = light;
    return m_live.emplace_back(count() - 1);
}

void LightStore::addDeleted(const KM_Light& light) {
    CQuarnLight& slot = m_slots.emplace_back();
    slot.m_light = light;
    slot.m_deleted = true;
}

bool LightStore::remove(int index) {
    if (at(index).IsDeleted())
        return false;
    m_slots[static_cast<std::size_t>(index)].m_deleted = true;
    m_live.erase(std::ranges::lower_bound(m_live, index));
    return true;
}

std::vector<KM_Light> LightStore::shiningLights(int but) const {
    std::vector<KM_Light> lights;
    for (const int index : m_live)
        if (index != but && at(index).Light().IsEnabled())
            lights.push_back(at(index).Light());
    return lights;
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
    return allowed ? m_lights->add(light) : quarn::LightStore::no_index;
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
