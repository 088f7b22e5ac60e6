#include "zoetrix/commands/DisplayModeChoices.h"

#include "sdk/qncore/QnDisplayAttributes.h"

std::vector<DisplayModeChoice> ListDisplayModes(bool sun_filter) {
    KM_SimpleArray<const CDisplayPipelineAttributes*> modes;
    CQuarnDisplayAttrsMgr::GetDisplayAttrsList(modes);
    std::vector<DisplayModeChoice> choices;
    for (const CDisplayPipelineAttributes* mode : modes) {
        if (!mode || (sun_filter && !mode->ShowsSunStudies()))
            continue;
        const CQuarnCommandOptionName name = QnCaptureOptionName(*mode);
        choices.push_back({name.m_local, name.m_english, mode->Id()});
    }
    return choices;
}
