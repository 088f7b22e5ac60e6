#include "quarn/scripts/CaptureMode.h"

#include "quarn/words/Words.h"
#include "sdk/qncore/QnDisplayAttributes.h"

#include <algorithm>
#include <vector>

namespace quarn::program {

namespace {

constexpr const char* RENDER_METHODS[] = {"RenderFull", "RenderPreview"};

/// The name without the characters that an option cannot hold, in lower case.
std::string comparable(std::string_view name) {
    std::string cleaned = lowerCase(name);
    std::erase_if(
        cleaned, [](char c) { return std::string_view("_ -,").find(c) != std::string_view::npos; });
    return cleaned;
}

CaptureMode displayMode(const CDisplayPipelineAttributes& mode) {
    const std::string name = mode.EnglishName().ToUtf8();
    // The prompt calls these two by names of its own. It offers sun studies other modes with lights
    // too, but the frames of a study are drawn in the rendered mode whichever was picked.
    if (comparable(name) == "rendered")
        return {name, "_RenderedViewport", true, false};
    if (comparable(name) == "xray")
        return {name, "_XRay", false, false};
    return {name, "_" + name, false, false};
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
