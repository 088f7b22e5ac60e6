#include "import/text/Words.h"

namespace quarn {

std::string quotedWord(std::string_view word) {
    constexpr std::size_t LONGEST = 40;
    std::string text = "'";
    for (const char c : word.substr(0, LONGEST))
        text += c >= 32 && c < 127 ? c : '?';
    return text + (word.size() > LONGEST ? "...'" : "'");
}

} // namespace quarn
