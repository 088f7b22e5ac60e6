#include "quarn/CaptureMode.h"

#include "quarn/Words.h"
#include "sdk/qncore/QnDisplayAttributes.h"

#include <algorithm>
#include <array>
#include <vector>

namespace quarn::program {

namespace {

const std::array<std::string, 2> RENDER_METHODS{"RenderFull", "RenderPreview"};

/// What two spellings of a name have in common.
std::string comparable(std::string_view name) {
    return lowerCase(QnCleanedModeName(KM_wString::FromUtf8(name)).ToUtf8());
}

struct CaptureMode {
    std::string name;   ///< as a person reads it
    std::string option; ///< as the prompt knows it
    bool draws_sun_studies;
};

/// The prompt offers sun studies every mode in which they can be seen, but their frames are drawn
/// in the rendered mode whichever was picked.
CaptureMode displayMode(const CDisplayPipelineAttributes& mode) {
    return {mode.EnglishName().ToUtf8(), "_" + QnCaptureOptionName(mode).m_english.ToUtf8(),
            mode.Id() == CQuarnDisplayAttrsMgr::RenderedModeId()};
}

std::vector<CaptureMode> captureModes() {
    KM_SimpleArray<const CDisplayPipelineAttributes*> display_modes;
    CQuarnDisplayAttrsMgr::GetDisplayAttrsList(display_modes);
    std::vector<CaptureMode> modes;
    for (int i = 0; i < display_modes.Count(); ++i)
        modes.push_back(displayMode(*display_modes[i]));
    for (const std::string& method : RENDER_METHODS)
        modes.push_back({method, "_" + method, true});
    return modes;
}

} // namespace

std::optional<std::string> captureOption(std::string_view name) {
    const std::string wanted = comparable(name);
    for (const CaptureMode& mode : captureModes())
        if (wanted == comparable(mode.name) || wanted == comparable(mode.option))
            return mode.option;
    return std::nullopt;
}

bool isRendered(std::string_view option) {
    return std::any_of(RENDER_METHODS.begin(), RENDER_METHODS.end(),
                       [&](const std::string& method) { return option == "_" + method; });
}

bool suitsSunStudies(std::string_view option) {
    for (const CaptureMode& mode : captureModes())
        if (mode.option == option)
            return mode.draws_sun_studies;
    return false;
}

std::string captureModeNames(CaptureSubject subject) {
    std::string names;
    for (const CaptureMode& mode : captureModes())
        if (subject != CaptureSubject::moving_sun || mode.draws_sun_studies)
            names += (names.empty() ? "" : ", ") + mode.name;
    return names;
}

} // namespace quarn::program
