#include "quarn/scripts/CaptureMode.h"

#include "quarn/words/Words.h"
#include "sdk/qncore/QnDisplayAttributes.h"

#include <algorithm>
#include <vector>

namespace quarn::program {

namespace {

constexpr const char* RENDER_METHODS[] = {"RenderFull", "RenderPreview"};

/// What two spellings of a name have in common.
std::string comparable(std::string_view name) {
    return lowerCase(QnCleanedModeName(KM_wString::FromUtf8(name)).ToUtf8());
}

/// The prompt offers sun studies every mode in which they can be seen, but their frames are drawn
/// in the rendered mode whichever was picked.
CaptureMode displayMode(const CDisplayPipelineAttributes& mode) {
    return {mode.EnglishName().ToUtf8(), "_" + QnCaptureOptionName(mode).m_english.ToUtf8(),
            mode.Id() == CQuarnDisplayAttrsMgr::RenderedModeId(), false};
}

std::vector<CaptureMode> captureModes() {
    KM_SimpleArray<const CDisplayPipelineAttributes*> display_modes;
    CQuarnDisplayAttrsMgr::GetDisplayAttrsList(display_modes);
    std::vector<CaptureMode> modes;
    for (int i = 0; i < display_modes.Count(); ++i)
        modes.push_back(displayMode(*display_modes[i]));
    for (const std::string method : RENDER_METHODS)
        modes.push_back({method, "_" + method, true, true});
    return modes;
}

} // namespace

std::optional<CaptureMode> captureMode(std::string_view name) {
    const std::string wanted = comparable(name);
    for (const CaptureMode& mode : captureModes())
        if (wanted == comparable(mode.name) || wanted == comparable(mode.option))
            return mode;
    return std::nullopt;
}

std::string captureModeNames(CaptureSubject subject) {
    std::string names;
    for (const CaptureMode& mode : captureModes())
        if (subject != CaptureSubject::moving_sun || mode.suits_sun_studies)
            names += (names.empty() ? "" : ", ") + mode.name;
    return names;
}

} // namespace quarn::program
