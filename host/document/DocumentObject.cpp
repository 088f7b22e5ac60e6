#include "host/document/DocumentObject.h"

#include "engine/scene/DrawableRange.h"
#include "host/border/Contract.h"
#include "host/document/DocumentList.h"

namespace quarn {

const wchar_t* DocumentObject::kind() const {
    if (placed.mesh)
        return L"mesh";
    return curve ? L"curve" : L"point";
}

KM_BoundingBox DocumentObject::boundingBox() const {
    if (placed.mesh)
        return meshMeasure().box;
    if (curve)
        return curve->BoundingBox();
    return point ? KM_BoundingBox(*point, *point) : KM_BoundingBox::EmptyBoundingBox;
}

bool DocumentObject::isInDrawableRange() const {
    return placed.mesh ? meshMeasure().is_in_range : quarn::isInDrawableRange(boundingBox());
}

const DocumentObject::MeshMeasure& DocumentObject::meshMeasure() const {
    if (!m_mesh_measure) {
        const KM_BoundingBox own_box = placed.mesh->BoundingBox();
        m_mesh_measure = {placed.box(own_box),
                          quarn::isInDrawableRange(own_box, placed.world_from_mesh)};
    }
    return *m_mesh_measure;
}

namespace {

const DocumentObject* findInOpenDocuments(const KM_UUID& id) {
    const DocumentList* list = DocumentList::current();
    if (!list || KM_UuidIsNil(id))
        return nullptr;
    if (const Document* active = list->active())
        if (const DocumentObject* object = active->objects().find(id))
            return object;
    for (const auto& document : list->documents())
        if (const DocumentObject* object = document->objects().find(id))
            return object;
    return nullptr;
}

} // namespace

} // namespace quarn

using quarn::isOnMainThread;

KM_UUID CQuarnObject::Id() const {
    return isOnMainThread("CQuarnObject::Id") ? m_object->id : KM_nil_uuid;
}

const wchar_t* CQuarnObject::Name() const {
    return isOnMainThread("CQuarnObject::Name") ? m_object->name.Array() : L"";
}

bool CQuarnObject::IsHidden() const {
    return isOnMainThread("CQuarnObject::IsHidden") && !m_object->visible;
}

const KM_Curve* CQuarnObject::Curve() const {
    return isOnMainThread("CQuarnObject::Curve") ? m_object->curve.get() : nullptr;
}

const KM_3dPoint* CQuarnObject::Point() const {
    const bool is_there = isOnMainThread("CQuarnObject::Point") && m_object->point;
    return is_there ? &*m_object->point : nullptr;
}

CQuarnObjRef::CQuarnObjRef() = default;

CQuarnObjRef::CQuarnObjRef(const KM_UUID& id) : m_id(id) {}

const CQuarnObject* CQuarnObjRef::Object() const {
    if (!isOnMainThread("CQuarnObjRef::Object"))
        return nullptr;
    const quarn::DocumentObject* object = quarn::findInOpenDocuments(m_id);
    return object ? &object->face : nullptr;
}

const KM_Curve* CQuarnObjRef::Curve() const {
    const CQuarnObject* object = Object();
    return object ? object->Curve() : nullptr;
}

const KM_3dPoint* CQuarnObjRef::Point() const {
    const CQuarnObject* object = Object();
    return object ? object->Point() : nullptr;
}
