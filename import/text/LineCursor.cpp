#include "import/text/LineCursor.h"

namespace quarn {

char lineBreakOf(std::string_view text) {
    const std::size_t first = text.find_first_of("\r\n");
    const bool is_return = first != std::string_view::npos && text[first] == '\r';
    // Some files end their lines with two returns and a feed.
    const std::size_t after = is_return ? text.find_first_not_of('\r', first) : first;
    return is_return && after != std::string_view::npos && text[after] != '\n' ? '\r' : '\n';
}

std::vector<std::string_view> partsOfLines(std::string_view text, std::size_t bytes,
                                           char line_break) {
    std::vector<std::string_view> parts;
    while (!text.empty()) {
        const std::size_t wanted = std::max<std::size_t>(bytes, 1) - 1;
        const std::size_t end = text.find(line_break, std::min(wanted, text.size()));
        parts.push_back(text.substr(0, end == std::string_view::npos ? end : end + 1));
        text.remove_prefix(parts.back().size());
    }
    return parts;
}

std::uint64_t countLines(std::string_view text, char line_break) {
    const auto breaks =
        static_cast<std::uint64_t>(std::count(text.begin(), text.end(), line_break));
    return breaks + (text.empty() || text.back() == line_break ? 0 : 1);
}

std::uint64_t lineNumberAt(std::string_view text, const char* place, char line_break) {
    return 1 + static_cast<std::uint64_t>(std::count(text.data(), place, line_break));
}

} // namespace quarn
