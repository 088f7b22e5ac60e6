#include "host/document/DisplayModeList.h"

#include "sdk/qncore/QnLocalize.h"

#include <algorithm>

namespace quarn {

namespace {

/// The texts by which the modes are named in the string tables.
constexpr struct {
    const wchar_t* english_name;
    int text_id;
} MODE_NAME_IDS[] = {
    {L"Wireframe", 32015}, {L"Shaded", 43001},  {L"Rendered", 19746}, {L"Translucent", 43002},
    {L"X-Ray", 20120},     {L"Drawing", 43003}, {L"Clay", 43004},
};

KM_wString localNameOf(const KM_wString& english_name) {
    for (const auto& entry : MODE_NAME_IDS)
        if (english_name == entry.english_name)
            return QnLocalizeString(entry.english_name, entry.text_id);
    return english_name;
}

CDisplayPipelineAttributes attributesOf(const DisplayModeAttributes& mode) {
    CDisplayPipelineAttributes attributes;
    attributes.m_id = mode.id;
    attributes.m_english_name = mode.english_name;
    attributes.m_mode_kind = static_cast<int>(mode.kind);
    attributes.m_uses_document_lights = mode.uses_document_lights;
    attributes.m_casts_shadows = mode.casts_shadows;
    attributes.m_antialiasing_level = mode.antialiasing_level;
    return attributes;
}

/// Whether a name that somebody gave is this one, as options compare.
bool isNamed(const KM_wString& cleaned, const KM_wString& name) {
    return cleaned.CompareNoCase(QnCleanedModeName(name)) == 0;
}

} // namespace

DisplayModeList& DisplayModeList::instance() {
    static DisplayModeList list;
    return list;
}

DisplayModeList::DisplayModeList() {
    for (const DisplayModeAttributes& mode : standardDisplayModes())
        m_modes.push_back(attributesOf(mode));
    localize();
}

void DisplayModeList::localize() {
    for (CDisplayPipelineAttributes& mode : m_modes)
        mode.m_local_name = localNameOf(mode.m_english_name);
}

const CDisplayPipelineAttributes* DisplayModeList::find(const KM_UUID& id) const {
    const auto found = std::find_if(m_modes.begin(), m_modes.end(),
                                    [&](const auto& mode) { return mode.Id() == id; });
    return found == m_modes.end() ? nullptr : &*found;
}

const CDisplayPipelineAttributes* DisplayModeList::findByName(std::wstring_view name) const {
    const KM_wString wanted = QnCleanedModeName(KM_wString(name));
    for (const CDisplayPipelineAttributes& mode : m_modes)
        if (isNamed(wanted, mode.EnglishName()) || isNamed(wanted, mode.LocalName()) ||
            isNamed(wanted, QnCaptureOptionName(mode).m_english))
            return &mode;
    return nullptr;
}

DisplayModeAttributes drawingAttributes(const CDisplayPipelineAttributes& attributes) {
    const DisplayModeAttributes* mode = findDisplayMode(attributes.Id());
    if (!mode)
        mode = findDisplayMode(shaded_mode_id);
    DisplayModeAttributes drawing = *mode;
    drawing.uses_document_lights = attributes.m_uses_document_lights;
    drawing.casts_shadows = attributes.m_casts_shadows;
    drawing.antialiasing_level = attributes.m_antialiasing_level;
    return drawing;
}

} // namespace quarn

CQuarnCommandOptionName QnCaptureOptionName(const CDisplayPipelineAttributes& mode) {
    const KM_wString name = QnCleanedModeName(mode.LocalName());
    if (quarn::isNamed(name, QnLocalizeString(L"Rendered", 19746)))
        return {L"RenderedViewport", QnLocalizeString(L"RenderedViewport", 19747)};
    if (quarn::isNamed(name, QnLocalizeString(L"X-Ray", 20120)))
        return {L"XRay", QnLocalizeString(L"XRay", 20121)};
    return {mode.EnglishName(), name};
}

int CQuarnDisplayAttrsMgr::GetDisplayAttrsList(
    KM_SimpleArray<const CDisplayPipelineAttributes*>& list) {
    list.Empty();
    for (const CDisplayPipelineAttributes& mode : quarn::DisplayModeList::instance().modes())
        list.Append(&mode);
    return list.Count();
}

const CDisplayPipelineAttributes* CQuarnDisplayAttrsMgr::FindDisplayAttrs(const KM_UUID& id) {
    return quarn::DisplayModeList::instance().find(id);
}

KM_UUID CQuarnDisplayAttrsMgr::WireframeModeId() {
    return quarn::wireframe_mode_id;
}

KM_UUID CQuarnDisplayAttrsMgr::RenderedModeId() {
    return quarn::rendered_mode_id;
}
