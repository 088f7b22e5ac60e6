#include "host/app/Border.h"
#include "host/document/DocumentList.h"
#include "host/front_end/FrontEnd.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

CQuarnDoc* CQuarnDoc::FromRuntimeSerialNumber(unsigned int serial_number) {
    const quarn::DocumentList* list = quarn::DocumentList::current();
    quarn::Document* document = list ? list->find(serial_number) : nullptr;
    return document ? &document->face() : nullptr;
}

unsigned int CQuarnDoc::RuntimeSerialNumber() const {
    return m_document->serialNumber();
}

int CQuarnDoc::GetViewList(KM_SimpleArray<CQuarnView*>& views, bool model_views, bool) const {
    views.Empty();
    if (model_views)
        for (const auto& view : m_document->views())
            views.Append(&view->face());
    return views.Count();
}

double CQuarnDoc::AbsoluteTolerance() const {
    return m_document->absoluteTolerance();
}

CQuarnDocProperties& CQuarnDoc::Properties() {
    return m_document->properties();
}

CQuarnLightTable& CQuarnDoc::LightTable() {
    return m_document->lights().face();
}

CQuarnSun& CQuarnDoc::Sun() {
    return m_document->sun().face();
}

const CQuarnObject* CQuarnDoc::FindObjectByName(const wchar_t* name) const {
    const quarn::DocumentObject* object = name ? m_document->objects().findByName(name) : nullptr;
    return object ? &object->face : nullptr;
}

bool CQuarnDoc::HideObject(const CQuarnObjRef& object, bool) {
    return m_document->objects().setVisible(object.ObjectUuid(), false);
}

bool CQuarnDoc::ShowObject(const CQuarnObjRef& object, bool) {
    return m_document->objects().setVisible(object.ObjectUuid(), true);
}

void CQuarnDoc::Regen() {
    m_document->regenerate();
}

KM_3dmAnimationProperties CQuarnDocProperties::AnimationProperties() const {
    const IQnZoetrixDynamicAccess* access = Zoetrix_QuarnDynamicAccess();
    if (!access)
        return {};
    auto record = quarn::acrossBorder([&]() -> KM_3dmAnimationProperties {
        return access->AnimationProperties(m_document->face());
    });
    return record ? record.value() : KM_3dmAnimationProperties();
}

void CQuarnDocProperties::SetAnimationProperties(const KM_3dmAnimationProperties& properties) {
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
