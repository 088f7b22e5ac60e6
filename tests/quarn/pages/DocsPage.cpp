#include "tests/quarn/pages/DocsPage.h"

#include "tests/quarn/ProgramRun.h"
#include "tests/support/TempFolder.h"

#include <algorithm>
#include <iterator>
#include <sstream>

namespace quarn::test {

std::string withoutIndent(const std::string& line) {
    const std::size_t first = line.find_first_not_of(' ');
    return first == std::string::npos ? std::string() : line.substr(first);
}

std::vector<std::vector<std::string>> fencedBlocks(const std::string& page) {
    std::vector<std::vector<std::string>> blocks;
    bool is_inside = false;
    for (const std::string& line :
         linesOf(readFile(std::filesystem::path(QUARN_SOURCE_DIR) / page))) {
        const std::string text = withoutIndent(line);
        if (text.starts_with("```")) {
            is_inside = !is_inside;
            if (is_inside)
                blocks.emplace_back();
        } else if (is_inside) {
            blocks.back().push_back(text);
        }
    }
    return blocks;
}

std::vector<std::string> argumentsOf(std::string line) {
    if (line.starts_with("$ "))
        line.erase(0, 2);
    if (!line.starts_with("quarn "))
        return {};
    std::istringstream words(line.substr(6));
    return {std::istream_iterator<std::string>(words), {}};
}

std::vector<std::vector<std::string>> commandsOn(const std::string& page,
                                                 const std::vector<std::string>& commands) {
    std::vector<std::vector<std::string>> found;
    for (const auto& block : fencedBlocks(page)) {
        for (const std::string& line : block) {
            const std::vector<std::string> arguments = argumentsOf(line);
            if (!arguments.empty() && std::ranges::count(commands, arguments[0]) > 0)
                found.push_back(arguments);
        }
    }
    return found;
}

} // namespace quarn::test
