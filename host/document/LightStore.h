#pragma once

#include "sdk/qncore/QnLightTable.h"

#include <vector>

namespace quarn {

/// The lights of a document. Slots of deleted lights stay, so that an index that was handed out
/// never means another light.
class LightStore {
public:
    /// Names no slot of any table.
    static constexpr int no_index = -1;

    LightStore() : m_face(*this) {}
    LightStore(const LightStore&) = delete;
    LightStore& operator=(const LightStore&) = delete;

    /// Whether a light has a style, a valid place and a direction where it needs one.
    static bool canShine(const KM_Light& light);

    int count() const { return static_cast<int>(m_slots.size()); }
    /// The light in a slot; one that counts as deleted for an index without a slot.
    const CQuarnLight& at(int index) const;
    /// @return the index of the light's slot, or no_index when the light cannot shine
    int add(const KM_Light& light);
    /// @return false, with nothing changed, when the index names no live light
    bool remove(int index);
    /// Adds the slot of a light that is gone, for the indices of a stored table to stay the same.
    void addDeleted(const KM_Light& light);

    /// The lights that are there and switched on.
    /// @param but  index of one that is left out; an index without a slot leaves out none
    std::vector<KM_Light> shiningLights(int but = -1) const;

    /// From now on every call of a plug-in is a breach.
    void close() { m_is_open = false; }
    bool isOpen() const { return m_is_open; }

    /// What plug-ins see of the table.
    CQuarnLightTable& face() { return m_face; }

private:
    std::vector<CQuarnLight> m_slots;
    /// The slots that are not deleted, ascending: a long sun study leaves a deleted one a frame,
    /// which the next frames must not pay for.
    std::vector<int> m_live;
    CQuarnLight m_no_light = deletedLight();
    CQuarnLightTable m_face;
    bool m_is_open = true;

    static CQuarnLight deletedLight();
};

} // namespace quarn
