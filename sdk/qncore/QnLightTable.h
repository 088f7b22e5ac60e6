#pragma once

#include "kelmar/KM_Light.h"
#include "sdk/qncore/QnExport.h"

namespace quarn {
class LightStore;
}
class KM_3dmObjectAttributes;

/// A light in a document's light table.
class QNCORE_API CQuarnLight {
public:
    /// True once the light was deleted; its slot stays.
    bool IsDeleted() const { return m_deleted; }
    const KM_Light& Light() const { return m_light; }

private:
    friend class quarn::LightStore;
    KM_Light m_light;
    bool m_deleted = false;
};

/// The lights of a document. Slots are never reused: an index stays good as long as its document,
/// also when its light was deleted.
///
/// All calls belong on the main thread and to an open document. Any other is a breach of the
/// interface: it is reported, changes nothing and behaves as for a table without lights that takes
/// none.
class QNCORE_API CQuarnLightTable {
public:
    /// How many slots there are, deleted ones too.
    int LightCount() const;

    /// The light in a slot. An index without a slot gives a light that counts as deleted. The
    /// reference is valid until a light is added or deleted.
    const CQuarnLight& operator[](int index) const;

    /// Adds a light. @param attributes  null for none (the only value understood)
    /// @return the index of its slot, or -1 when the light is not valid
    int AddLight(const KM_Light& light, const KM_3dmObjectAttributes* attributes);

    /// Deletes a light.
    /// @param quiet  say nothing when there is no such light
    /// @return true when a light was deleted; false when the index names no live light, and then
    ///         nothing changes
    bool DeleteLight(int index, bool quiet);

private:
    friend class quarn::LightStore;
    explicit CQuarnLightTable(quarn::LightStore& lights) : m_lights(&lights) {}
    quarn::LightStore* m_lights;
};
