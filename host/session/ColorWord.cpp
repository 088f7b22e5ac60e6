#include "host/session/ColorWord.h"

#include "host/commands/ColorText.h"

namespace quarn {

std::optional<std::string> colorWord(const std::string& word) {
    const auto color = colorFromText(KM_wString::FromUtf8(word).View());
    return color ? std::optional(colorText(*color).ToUtf8()) : std::nullopt;
}

} // namespace quarn
