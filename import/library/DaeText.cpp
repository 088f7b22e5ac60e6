#include "import/library/DaeText.h"

#include <algorithm>

namespace quarn {

std::string withoutBlanksBehindTags(std::string_view text) {
    std::string tight;
    tight.reserve(text.size());
    while (!text.empty()) {
        const std::size_t behind_tag = std::min(text.find('>'), text.size() - 1) + 1;
        tight += text.substr(0, behind_tag);
        text.remove_prefix(behind_tag);
        text.remove_prefix(std::min(text.find_first_not_of(" \t\r\n"), text.size()));
    }
    return tight;
}

} // namespace quarn
