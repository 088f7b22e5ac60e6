#pragma once

#include <string>

namespace quarn::program {

/// What pictures are to be lit by, as answers of the command RenderSettings; an empty one leaves it
/// as the document has it.
struct LightRequest {
    std::string surroundings; ///< "_Studio", or "_Picture" and a path
    std::string exposure;     ///< "_Automatic", or a number
    std::string background;   ///< "_Transparent", or "_Colour" and a colour
    std::string ground;       ///< "Yes" or "No"

    bool isTransparent() const { return background == TRANSPARENT; }

    static constexpr const char* TRANSPARENT = "_Transparent";
};

/// " _Light _Studio _Exposure 1.5"; empty where nothing is asked for.
std::string lightAnswers(const LightRequest& request);

/// The line of RenderSettings.
/// @param answers  each with a blank before it
std::string renderSettingsLine(const std::string& answers);

} // namespace quarn::program
