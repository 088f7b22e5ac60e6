#include "quarn/CaptureMode.h"

#include "quarn/Words.h"
#include "sdk/qncore/QnDisplayAttributes.h"

#include <vector>

namespace quarn::program {

namespace {

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
};

CaptureMode displayMode(const CDisplayPipelineAttributes& mode) {
    const std::string name = mode.EnglishName().ToUtf8();
    // The prompt calls these two by names of its own.
    if (comparable(name) == "rendered")
        return {name, "_RenderedViewport"};
    if (comparable(name) == "xray")
        return {name, "_XRay"};
    return {name, "_" + name};
}

std::vector<CaptureMode> captureModes() {
    KM_SimpleArray<const CDisplayPipelineAttributes*> display_modes;
    CQuarnDisplayAttrsMgr::GetDisplayAttrsList(display_modes);
    std::vector<CaptureMode> modes;
    for (int i = 0; i < display_modes.Count(); ++i)
        modes.push_back(displayMode(*display_modes[i]));
    modes.push_back({"RenderFull", "_RenderFull"});
    modes.push_back({"RenderPreview", "_RenderPreview"});
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

std::string captureModeNames() {
    std::string names;
    for (const CaptureMode& mode : captureModes())
        names += (names.empty() ? "" : ", ") + mode.name;
    return names;
}

} // namespace quarn::program
