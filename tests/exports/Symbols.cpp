#include "tests/exports/Symbols.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <cstdio>
#include <fstream>
#include <memory>
#include <regex>
#include <sstream>
#include <stdexcept>

namespace exports {
namespace {

std::string outputOf(const std::string& command) {
    const std::unique_ptr<FILE, int (*)(FILE*)> pipe(popen(command.c_str(), "r"), &pclose);
    if (pipe == nullptr) {
        throw std::runtime_error("cannot run " + command);
    }
    std::string output;
    std::array<char, 4096> block;
    while (const std::size_t count = std::fread(block.data(), 1, block.size(), pipe.get())) {
        output.append(block.data(), count);
    }
    return output;
}

/// Removes what marks a table, a type's name, a thunk or a guard (Itanium C++ ABI, 5.1.4).
std::string_view withoutSpecialPrefix(std::string_view symbol) {
    static const std::regex pattern(
        R"(^_Z(?:T[VTIS]|TC|Th[n0-9]+_|Tv[n0-9]+_[n0-9]+_|Tc(?:h[n0-9]+_|v[n0-9]+_[n0-9]+_){2}|GV|GR)?Z*)");
    std::cmatch match;
    std::regex_search(symbol.data(), symbol.data() + symbol.size(), match, pattern);
    return symbol.substr(static_cast<std::size_t>(match.length()));
}

/// Takes one `<length><identifier>` off the front; empty if there is none.
std::string takeIdentifier(std::string_view& rest) {
    std::size_t length = 0;
    while (!rest.empty() && std::isdigit(static_cast<unsigned char>(rest.front()))) {
        length = length * 10 + static_cast<std::size_t>(rest.front() - '0');
        rest.remove_prefix(1);
    }
    const std::string identifier(rest.substr(0, length));
    rest.remove_prefix(std::min(length, rest.size()));
    return identifier;
}

} // namespace

std::vector<std::string> exportedSymbols(const std::filesystem::path& library) {
    std::istringstream lines(outputOf(
        std::string(QUARN_NM) + " -D --defined-only --format=posix '" + library.string() + "'"));
    std::vector<std::string> symbols;
    for (std::string line; std::getline(lines, line);) {
        std::istringstream words(line);
        std::string name;
        std::string kind;
        words >> name >> kind;
        if (kind != "A") {
            symbols.push_back(name.substr(0, name.find('@')));
        }
    }
    std::ranges::sort(symbols);
    return symbols;
}

std::vector<std::string> qualifiedName(std::string_view symbol) {
    if (!symbol.starts_with("_Z")) {
        return {std::string(symbol)};
    }
    std::string_view rest = withoutSpecialPrefix(symbol);
    const bool nested = rest.starts_with('N');
    if (nested) {
        rest.remove_prefix(1);
        rest.remove_prefix(std::min(rest.find_first_not_of("VKrRO"), rest.size()));
    }
    if (rest.starts_with('S')) {
        return {"std"};
    }
    std::vector<std::string> parts;
    for (std::string part; !(part = takeIdentifier(rest)).empty();) {
        parts.push_back(part);
        if (!nested) {
            break;
        }
    }
    return parts;
}

std::string declarationsBelow(const std::filesystem::path& folder) {
    std::string text;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(folder)) {
        if (entry.path().extension() != ".h") {
            continue;
        }
        std::ifstream file(entry.path());
        for (std::string line; std::getline(file, line);) {
            text += line.substr(0, line.find("//")) + "\n";
        }
    }
    return text;
}

bool mentions(const std::string& text, const std::string& identifier) {
    const auto isWord = [&](std::size_t at) {
        return at < text.size() &&
               (std::isalnum(static_cast<unsigned char>(text[at])) || text[at] == '_');
    };
    for (std::size_t at = text.find(identifier); at != std::string::npos;
         at = text.find(identifier, at + 1)) {
        if ((at == 0 || !isWord(at - 1)) && !isWord(at + identifier.size())) {
            return true;
        }
    }
    return false;
}

} // namespace exports
