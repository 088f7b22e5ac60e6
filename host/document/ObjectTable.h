#pragma once

#include "host/document/DocumentObject.h"

#include <cstdint>
#include <map>
#include <memory>
#include <span>
#include <string_view>
#include <vector>

namespace quarn {

/// The objects of a document, in the order in which they were added.
class ObjectTable {
public:
    /// Adds an object. A name that another object has already gets a number behind it ("Wall 2"),
    /// so that a name typed by a person means one object.
    /// @param id  the id that it had in a file; a new one is made for the nil id, and for one that
    ///            another object has already
    /// @return the object; valid until it is removed
    DocumentObject& addMesh(const KM_wString& name, PlacedMesh placed,
                            const KM_UUID& id = KM_nil_uuid);
    DocumentObject& addCurve(const KM_wString& name, std::unique_ptr<KM_Curve> curve,
                             const KM_UUID& id = KM_nil_uuid);
    DocumentObject& addPoint(const KM_wString& name, const KM_3dPoint& point,
                             const KM_UUID& id = KM_nil_uuid);

    /// Removes an object. @return false when there is none with this id
    bool remove(const KM_UUID& id);
    /// Removes the objects with these ids; ids that no object has are passed over.
    /// @return how many were removed
    std::size_t remove(std::span<const KM_UUID> ids);

    /// Gives an object another name; an empty one leaves it without.
    /// @return false, with nothing changed, when there is no object with this id or another object
    ///         has the name, ignoring case
    bool rename(const KM_UUID& id, const KM_wString& name);

    /// Gives a curve object another curve; it keeps its id, name and all else.
    /// @return false, with nothing changed, when there is no curve object with this id or no curve
    bool replaceCurve(const KM_UUID& id, std::unique_ptr<KM_Curve> curve);
    /// Moves a point object.
    /// @return false, with nothing changed, when there is no point object with this id
    bool movePoint(const KM_UUID& id, const KM_3dPoint& point);

    /// The object with this id, or null.
    DocumentObject* find(const KM_UUID& id) const;
    /// The object with this name, ignoring case, or null.
    DocumentObject* findByName(std::wstring_view name) const;

    /// Shows or hides an object. @return true when its visibility changed
    bool setVisible(const KM_UUID& id, bool visible);

    /// Selects an object, or takes it out of the selection. Removed objects are in it no more.
    /// @return false when there is none with this id
    bool select(const KM_UUID& id, bool selected = true);
    /// Selects every visible object besides what is selected.
    void selectAll();
    void selectNone();
    int selectedCount() const;

    const std::vector<std::unique_ptr<DocumentObject>>& objects() const { return m_objects; }
    bool empty() const { return m_objects.empty(); }

    /// The box of all visible objects; not valid when there are none.
    KM_BoundingBox visibleBox() const;

    /// Rises whenever an object is added, removed or changed, but not when it is shown, hidden,
    /// selected or renamed.
    std::uint64_t revision() const { return m_revision; }
    /// Rises whenever anything but the selection changes.
    std::uint64_t changeCount() const { return m_revision + m_small_changes; }

private:
    DocumentObject& add(const KM_wString& name, const KM_UUID& id);
    KM_wString freeName(const KM_wString& wish);
    void noteChange(DocumentObject& object, std::uint64_t& count);

    std::vector<std::unique_ptr<DocumentObject>> m_objects;
    std::map<KM_UUID, DocumentObject*> m_by_id;
    std::map<KM_wString, DocumentObject*> m_by_name; ///< by the name in lower case
    std::map<KM_wString, int> m_last_number;         ///< by the name in lower case
    std::uint64_t m_revision = 1;
    std::uint64_t m_small_changes = 0; ///< of names and visibility
};

} // namespace quarn
