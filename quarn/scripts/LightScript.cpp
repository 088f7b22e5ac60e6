#include "quarn/scripts/LightScript.h"

namespace quarn::program {

namespace {

std::string answer(const char* option, const std::string& value) {
    return value.empty() ? "" : option + value;
}

} // namespace

std::string lightAnswers(const LightRequest& request) {
    return answer(" _Light ", request.surroundings) + answer(" _Exposure ", request.exposure) +
           answer(" _Background ", request.background) + answer(" _Ground=", request.ground);
}

std::string renderSettingsLine(const std::string& answers) {
    return "_-RenderSettings" + answers + " _Enter";
}

} // namespace quarn::program
