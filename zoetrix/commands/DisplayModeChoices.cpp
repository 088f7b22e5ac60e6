#include "zoetrix/commands/DisplayModeChoices.h"

#include "sdk/qncore/QnDisplayAttributes.h"
#include "sdk/qncore/QnLocalize.h"

namespace {

KM_wString CleanedName(KM_wString name) {
    for (const wchar_t character : {L'_', L' ', L'-', L','})
        name.Remove(character);
    return name;
}

bool ShowsSunStudies(const CDisplayPipelineAttributes& mode) {
    return mode.m_mode_kind == CDisplayPipelineAttributes::shaded &&
           (mode.m_uses_document_lights || mode.m_casts_shadows);
}

DisplayModeChoice ChoiceOf(const CDisplayPipelineAttributes& mode) {
    const KM_wString name = CleanedName(mode.LocalName());
    // Both sides are cleaned: a name that itself holds a dash would never be found otherwise.
    if (name.CompareNoCase(CleanedName(QnLocalizeString(L"Rendered", 19746))) == 0)
        return {QnLocalizeString(L"RenderedViewport", 19747), L"RenderedViewport", mode.Id()};
    if (name.CompareNoCase(CleanedName(QnLocalizeString(L"X-Ray", 20120))) == 0)
        return {QnLocalizeString(L"XRay", 20121), L"XRay", mode.Id()};
    return {name, mode.EnglishName(), mode.Id()};
}

} // namespace

std::vector<DisplayModeChoice> ListDisplayModes(bool sun_filter) {
    KM_SimpleArray<const CDisplayPipelineAttributes*> modes;
    CQuarnDisplayAttrsMgr::GetDisplayAttrsList(modes);
    std::vector<DisplayModeChoice> choices;
    for (const CDisplayPipelineAttributes* mode : modes) {
        if (mode && (!sun_filter || ShowsSunStudies(*mode)))
            choices.push_back(ChoiceOf(*mode));
    }
    return choices;
}
