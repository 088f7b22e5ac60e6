#pragma once

#include "sdk/qncore/QnLightTable.h"

#include <map>
#include <set>
#include <vector>

namespace quarn {

/// Which of the lights that are there and on shine.
enum class ShiningLights {
    all,
    of_plug_ins, ///< those that plug-ins put there since the document was opened
};

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
    /// @param but  index of one that is left out; an index without a slot leaves out none
    std::vector<KM_Light> shiningLights(ShiningLights which = ShiningLights::all,
                                        int but = no_index) const;
    /// Whether a plug-in has put a light there that shines from one direction, as a sun does.
    bool hasStudySun() const;

    /// From now on every call of a plug-in is a breach.
    void close() { m_is_open = false; }
    bool isOpen() const { return m_is_open; }

    /// What plug-ins see of the table.
    CQuarnLightTable& face() { return m_face; }

private:
    std::map<int, CQuarnLight> m_live;
    std::set<int> m_of_plug_ins; ///< indices of live ones
    int m_slot_count = 0;
    CQuarnLight m_no_light = deletedLight();
    CQuarnLightTable m_face;
    bool m_is_open = true;

    static CQuarnLight deletedLight();
};

} // namespace quarn
