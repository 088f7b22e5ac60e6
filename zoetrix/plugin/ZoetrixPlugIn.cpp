#include "zoetrix/plugin/ZoetrixPlugIn.h"

#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"
#include "zoetrix/paths/ZoetrixDynamicAccess.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

CZoetrixPlugIn::CZoetrixPlugIn() : m_version(L"" __DATE__ "  " __TIME__) {}

CZoetrixPlugIn::~CZoetrixPlugIn() {
    RemoveDynamicAccess();
}

const wchar_t* CZoetrixPlugIn::PlugInName() const {
    return L"Zoetrix";
}

const wchar_t* CZoetrixPlugIn::LocalPlugInName() const {
    return QnLocalizeString(L"Zoetrix", 19628);
}

const wchar_t* CZoetrixPlugIn::PlugInVersion() const {
    return m_version;
}

KM_UUID CZoetrixPlugIn::PlugInID() const {
    return ZoetrixPlugInId;
}

CQuarnPlugIn::plugin_load_time CZoetrixPlugIn::PlugInLoadTime() const {
    return load_when_needed;
}

bool CZoetrixPlugIn::OnLoadPlugIn() {
    m_dynamic_access = std::make_unique<CZoetrixDynamicAccess>();
    Zoetrix_SetQuarnDynamicAccess(m_dynamic_access.get());
    CZoetrixUtilities::InitializeAnimationProperties(m_animation);
    return CQuarnPlugIn::OnLoadPlugIn();
}

void CZoetrixPlugIn::OnUnloadPlugIn() {
    RemoveDynamicAccess();
    CQuarnPlugIn::OnUnloadPlugIn();
}

const KM_3dmAnimationProperties& CZoetrixPlugIn::AnimationProperties(const CQuarnDoc&) const {
    return m_animation;
}

KM_3dmAnimationProperties& CZoetrixPlugIn::AnimationPropertiesForWrite(const CQuarnDoc&) {
    return m_animation;
}

void CZoetrixPlugIn::SetAnimationProperties(const CQuarnDoc&,
                                            const KM_3dmAnimationProperties& props) {
    m_animation = props;
}

void CZoetrixPlugIn::RemoveDynamicAccess() {
    Zoetrix_SetQuarnDynamicAccess(nullptr);
    m_dynamic_access.reset();
}
