#pragma once

#include "sdk/qncore/QnLightTable.h"

#include <map>
#include <optional>
#include <vector>

namespace quarn {

/// The lights of a document. Slots of deleted lights stay, so that an index that was handed out
/// never means another light; they take no memory and no time, as a sun study leaves one a frame.
class LightStore {
public:
    /// Names no slot of any table.
    static constexpr int no_index = -1;
    /// The most slots that a table can have.
    static constexpr int most_slots = 1 << 24;

    LightStore() : m_face(*this) {}
    LightStore(const LightStore&) = delete;
    LightStore& operator=(const LightStore&) = delete;

    /// Whether a light has a style, a valid place and a direction where it needs one.
    static bool canShine(const KM_Light& light);

    /// How many slots there are, deleted ones too.
    int count() const { return m_slot_count; }
    /// The light in a slot; one that counts as deleted for an index without a slot.
    const CQuarnLight& at(int index) const;
    /// @return the index of the light's slot, or no_index when the light cannot shine or the table
    ///         is full
    int add(const KM_Light& light);
    /// The same of a light that a plug-in puts there.
    int addOfPlugIn(const KM_Light& light);
    /// @return false, with nothing changed, when the index names no live light
    bool remove(int index);
    /// Adds slots of deleted lights until there are `count`, for the indices of a stored table to
    /// stay the same. Above most_slots there are that many; a table is never made shorter.
    void addDeletedUpTo(int count);

    /// The lights that are not deleted, by their indices.
    const std::map<int, CQuarnLight>& live() const { return m_live; }

    /// The lights that are there and switched on.
    std::vector<KM_Light> shiningLights() const;
    /// The light that a plug-in put there last, while it is there, if it is on and shines from one
    /// direction, as the sun of a study does. Nothing where there is none. One that cannot shine,
    /// and so has no slot, counts until a plug-in puts another one there.
    std::optional<KM_Light> studySun() const;

    /// From now on every call of a plug-in is a breach.
    void close() { m_is_open = false; }
    bool isOpen() const { return m_is_open; }

    /// What plug-ins see of the table.
    CQuarnLightTable& face() { return m_face; }

private:
    std::map<int, CQuarnLight> m_live;
    int m_last_of_plug_in = no_index;
    std::optional<KM_Light> m_dark_of_plug_in; ///< the last one, where it cannot shine
    int m_slot_count = 0;
    CQuarnLight m_no_light = deletedLight();
    CQuarnLightTable m_face;
    bool m_is_open = true;

    static CQuarnLight deletedLight();
};

} // namespace quarn
