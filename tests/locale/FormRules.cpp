#include "tests/locale/TextRules.h"

#include <algorithm>
#include <regex>

namespace locale_rules {
namespace {

/// Codes of the kind %1 name their value, so their order is the language's own.
bool areNamed(const std::vector<std::string>& codes) {
    return std::ranges::all_of(codes, [](const std::string& code) {
        return code.size() == 2 && code[1] >= '1' && code[1] <= '9';
    });
}

std::string blanksAtEnd(const std::string& text) {
    return text.substr(text.find_last_not_of(" \n\t") + 1);
}

std::string blanksAtBegin(const std::string& text) {
    return text.substr(0, std::min(text.find_first_not_of(" \n\t"), text.size()));
}

/// Letters to press: an ampersand before anything but a blank or another one.
std::size_t accessKeys(const std::string& text) {
    static const std::regex key("&[^ &]");
    return static_cast<std::size_t>(
        std::distance(std::sregex_iterator(text.begin(), text.end(), key), {}));
}

} // namespace

std::vector<std::string> formatCodes(const std::string& text) {
    static const std::regex code(
        "%(?:[1-9](?![0-9.$]*[a-zA-Z])|"
        "[-+#0]*(?:[0-9]+|\\*)?(?:\\.[0-9]+)?(?:hh|ll|[hlLzjt])?[a-zA-Z%])");
    std::vector<std::string> codes;
    for (std::sregex_iterator found(text.begin(), text.end(), code), end; found != end; ++found)
        if (found->str() != "%%")
            codes.push_back(found->str());
    return codes;
}

std::vector<std::string> faultsOfForm(const Translation& text) {
    std::vector<std::string> faults;
    std::vector<std::string> wanted = formatCodes(text.english);
    std::vector<std::string> codes = formatCodes(text.local);
    if (areNamed(wanted)) {
        std::ranges::sort(wanted);
        std::ranges::sort(codes);
    }
    if (codes != wanted)
        faults.push_back("other format codes than in English");
    if (text.local.empty())
        faults.push_back("empty");
    if (blanksAtEnd(text.local) != blanksAtEnd(text.english) ||
        blanksAtBegin(text.local) != blanksAtBegin(text.english))
        faults.push_back("other blanks or line breaks at its ends than in English");
    if (std::ranges::count(text.local, '\n') != std::ranges::count(text.english, '\n'))
        faults.push_back("other line breaks than in English");
    if (accessKeys(text.local) != accessKeys(text.english))
        faults.push_back("other access keys (&) than in English");
    if (text.space != Space::strings &&
        text.local.find_first_of(" =,\"[]()<>\t\n") != std::string::npos)
        faults.push_back("a blank or a sign that no option can be called by");
    if (text.space != Space::strings && text.local.starts_with('_'))
        faults.push_back("begins with the mark of English options");
    return faults;
}

} // namespace locale_rules
