#include "host/border/Border.h"
#include "host/border/Contract.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentList.h"
#include "host/front_end/FrontEnd.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

using quarn::mayCallDocument;

// ---- CQuarnDoc

CQuarnDoc* CQuarnDoc::FromRuntimeSerialNumber(unsigned int serial_number) {
    if (!quarn::isOnMainThread("CQuarnDoc::FromRuntimeSerialNumber"))
        return nullptr;
    const quarn::DocumentList* list = quarn::DocumentList::current();
    quarn::Document* document = list ? list->find(serial_number) : nullptr;
    return document ? &document->face() : nullptr;
}

unsigned int CQuarnDoc::RuntimeSerialNumber() const {
    mayCallDocument(*m_document, "CQuarnDoc::RuntimeSerialNumber");
    return m_document->serialNumber();
}

int CQuarnDoc::GetViewList(KM_SimpleArray<CQuarnView*>& views, bool model_views, bool) const {
    views.Empty();
    if (mayCallDocument(*m_document, "CQuarnDoc::GetViewList") && model_views)
        for (const auto& view : m_document->views())
            views.Append(&view->face());
    return views.Count();
}

double CQuarnDoc::AbsoluteTolerance() const {
    const bool allowed = mayCallDocument(*m_document, "CQuarnDoc::AbsoluteTolerance");
    return allowed ? m_document->absoluteTolerance() : quarn::Document::default_absolute_tolerance;
}

CQuarnDocProperties& CQuarnDoc::Properties() {
    mayCallDocument(*m_document, "CQuarnDoc::Properties");
    return m_document->properties();
}

CQuarnLightTable& CQuarnDoc::LightTable() {
    mayCallDocument(*m_document, "CQuarnDoc::LightTable");
    return m_document->lights().face();
}

CQuarnSun& CQuarnDoc::Sun() {
    mayCallDocument(*m_document, "CQuarnDoc::Sun");
    return m_document->sun().face();
}

const CQuarnObject* CQuarnDoc::FindObjectByName(const wchar_t* name) const {
    if (!mayCallDocument(*m_document, "CQuarnDoc::FindObjectByName") || !name)
        return nullptr;
    const quarn::DocumentObject* object = m_document->objects().findByName(name);
    return object ? &object->face : nullptr;
}

bool CQuarnDoc::HideObject(const CQuarnObjRef& object, bool) {
    return mayCallDocument(*m_document, "CQuarnDoc::HideObject") &&
           m_document->objects().setVisible(object.ObjectUuid(), false);
}

bool CQuarnDoc::ShowObject(const CQuarnObjRef& object, bool) {
    return mayCallDocument(*m_document, "CQuarnDoc::ShowObject") &&
           m_document->objects().setVisible(object.ObjectUuid(), true);
}

void CQuarnDoc::Regen() {
    if (!mayCallDocument(*m_document, "CQuarnDoc::Regen"))
        return;
    if (const auto updated = m_document->drawing().regenerate(); !updated)
        m_document->frontEnd().print(KM_wString::FromUtf8(updated.message() + "\n").View());
}

// ---- CQuarnDocProperties

KM_3dmAnimationProperties CQuarnDocProperties::AnimationProperties() const {
    if (!mayCallDocument(*m_document, "CQuarnDocProperties::AnimationProperties"))
        return {};
    const IQnZoetrixDynamicAccess* access = Zoetrix_QuarnDynamicAccess();
    if (!access)
        return {};
    auto record = quarn::acrossBorder([&]() -> KM_3dmAnimationProperties {
        return access->AnimationProperties(m_document->face());
    });
    return record ? record.value() : KM_3dmAnimationProperties();
}

void CQuarnDocProperties::SetAnimationProperties(const KM_3dmAnimationProperties& properties) {
    if (!mayCallDocument(*m_document, "CQuarnDocProperties::SetAnimationProperties"))
        return;
    IQnZoetrixDynamicAccess* access = Zoetrix_QuarnDynamicAccess();
    if (!access)
        return;
    const auto stored = quarn::acrossBorder(
        [&] { access->SetAnimationProperties(m_document->face(), properties); });
    if (!stored)
        m_document->frontEnd().print(
            KM_wString::FromUtf8("The animation could not be stored: " + stored.message() + "\n")
                .View());
}
