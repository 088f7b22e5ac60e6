#pragma once

#include "kelmar/KM_Curve.h"
#include "kelmar/KM_Point.h"
#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"

#include <memory>

namespace quarn {
struct DocumentObject;
}

/// Something in a document: a mesh, a curve or a point. Owned by its document. A call on another
/// thread than the main one is a breach of the interface: it is reported and returns nil, an empty
/// name, false or null.
class QNCORE_API CQuarnObject {
public:
    KM_UUID Id() const;
    const wchar_t* Name() const; ///< empty when it has none; valid until the object is renamed
    bool IsHidden() const;
    /// The object's curve, or null when it is none. Valid until the object changes.
    const KM_Curve* Curve() const;
    /// Where the point object is, or null when it is none. Valid until the object changes.
    const KM_3dPoint* Point() const;

private:
    friend struct quarn::DocumentObject;
    explicit CQuarnObject(quarn::DocumentObject& object) : m_object(&object) {}
    quarn::DocumentObject* m_object;
};

/// A reference to an object of an open document by its id. It names the object and keeps nothing
/// alive: what it returns is null once the object is gone, and the object again when it is back. On
/// another thread than the main one Object, Curve and Point are breaches of the interface, and
/// null.
class QNCORE_API CQuarnObjRef {
public:
    /// Refers to nothing.
    CQuarnObjRef();
    /// Refers to the object with this id in the active document, or, when it has none of that id,
    /// in any open document. An id that names nothing is allowed.
    explicit CQuarnObjRef(const KM_UUID& id);

    KM_UUID ObjectUuid() const { return m_id; }
    /// The object, or null when the id names none (any more). Valid until the document changes.
    const CQuarnObject* Object() const;
    /// The object's curve, or null when there is no object or it is no curve. Valid until the
    /// document changes.
    const KM_Curve* Curve() const;
    /// Where the point object is, or null when there is no object or it is no point. Valid until
    /// the document changes.
    const KM_3dPoint* Point() const;

private:
    KM_UUID m_id = KM_nil_uuid;
};
