#pragma once

#include "engine/scene/PlacedMesh.h"
#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Curve.h"
#include "sdk/qncore/QnObject.h"

#include <memory>
#include <optional>

namespace quarn {

struct ObjectContent;

/// An object of a document: exactly one of mesh, curve and point is there. Owned by its
/// ObjectTable; others keep its id.
struct DocumentObject {
    DocumentObject() : face(*this) {}
    DocumentObject(const DocumentObject&) = delete;
    DocumentObject& operator=(const DocumentObject&) = delete;

    KM_UUID id = KM_nil_uuid; ///< never changes
    KM_wString name;          ///< empty when it has none
    bool visible = true;
    bool selected = false; ///< by a person, for the commands that work on a selection

    PlacedMesh placed; ///< its mesh is null in other objects; set before the first use
    std::unique_ptr<KM_Curve> curve;
    std::optional<KM_3dPoint> point;

    /// "mesh", "curve" or "point", in English.
    const wchar_t* kind() const;
    /// The box of the object in world coordinates.
    KM_BoundingBox boundingBox() const;

    CQuarnObject face; ///< what plug-ins see of it

    /// A copy that was made since the object changed last, for other threads; null: there is none.
    mutable std::shared_ptr<const ObjectContent> copy;

private:
    mutable std::optional<KM_BoundingBox> m_mesh_box; ///< found when it is first asked for
};

} // namespace quarn
