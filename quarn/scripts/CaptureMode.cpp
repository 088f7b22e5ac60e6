#include "quarn/scripts/CaptureMode.h"

#include "quarn/words/Words.h"
#include "sdk/qncore/QnDisplayAttributes.h"

#include <algorithm>
#include <array>
#include <vector>

namespace quarn::program {

namespace {

const std::array<std::string, 2> RENDER_METHODS{"RenderFull", "RenderPreview"};

/// The name without the characters that an option cannot hold, in lower case.
std::string comparable(std::string_view name) {
    std::string cleaned = lowerCase(name);
    std::erase_if(
        cleaned, [](char c) { return std::string_view("_ -,").find(c) != std::string_view::npos; });
    return cleaned;
}

struct CaptureMode {
    std::string name;   ///< as a person reads it
    std::string option; ///< as the prompt knows it
    bool suits_sun_studies;
};

CaptureMode displayMode(const CDisplayPipelineAttributes& mode) {
    const std::string name = mode.EnglishName().ToUtf8();
    // The prompt calls these two by names of its own. It offers sun studies other modes with lights
    // too, but the frames of a study are drawn in the rendered mode whichever was picked.
    if (comparable(name) == "rendered")
        return {name, "_RenderedViewport", true};
    if (comparable(name) == "xray")
        return {name, "_XRay", false};
    return {name, "_" + name, false};
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
            return mode.suits_sun_studies;
    return false;
}

std::string captureModeNames(CaptureSubject subject) {
    std::string names;
    for (const CaptureMode& mode : captureModes())
        if (subject != CaptureSubject::moving_sun || mode.suits_sun_studies)
            names += (names.empty() ? "" : ", ") + mode.name;
    return names;
}

} // namespace quarn::program
