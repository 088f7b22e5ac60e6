#include "tests/layers/IncludeRules.h"

#include <algorithm>
#include <array>
#include <fstream>
#include <regex>
#include <span>
#include <sstream>
#include <string_view>

namespace layers {
namespace {

namespace fs = std::filesystem;

/// What the files below one place may include, quoted, besides the files of that place itself.
struct Rule {
    std::string_view place;                       ///< a path prefix of the including file
    std::array<std::string_view, 8> allowed = {}; ///< path prefixes of the included file
    bool knows_itself = true;
    bool standard_library_only = false; ///< no `<...>` but the language's own headers
    bool knows_cocoa = false;           ///< Objective-C++, which may use its frameworks
};

constexpr std::string_view ALL_OF_ZOETRIX = "zoetrix/";
constexpr std::string_view UTILITIES = "zoetrix/plugin/ZoetrixUtilities.h";

/// The first rule whose place matches decides, so the narrower places stand first.
constexpr Rule RULES[] = {
    {"kelmar/", {}, true, true},
    {"sdk/cocoa/", {"sdk/", "kelmar/"}, true, true, true},
    {"sdk/", {"kelmar/"}, true, true},
    {"zoetrix/sun/VyrSun", {"zoetrix/sun/VyrSun.h"}, false, true},
    {"zoetrix/sun/", {"sdk/", "kelmar/", UTILITIES}, true, true},
    {"zoetrix/ui/QXTurnTableDialogController",
     {"sdk/", "kelmar/", "zoetrix/ui/"},
     false,
     true,
     true},
    {"zoetrix/ui/", {"sdk/", "kelmar/", UTILITIES}, true, true},
    {"zoetrix/plugin/", {"sdk/", "kelmar/", "zoetrix/paths/"}, true, true},
    {"zoetrix/paths/", {"sdk/", "kelmar/", "zoetrix/plugin/"}, true, true},
    {"zoetrix/commands/",
     {"sdk/", "kelmar/", "zoetrix/plugin/", "zoetrix/paths/", "zoetrix/sun/", "zoetrix/ui/"},
     true,
     true},
    {"zoetrix/", {"sdk/", "kelmar/", ALL_OF_ZOETRIX}, true, true},
    {"vexui/", {"sdk/", "kelmar/"}, true, false},
    {"host/cocoa/", {"sdk/", "kelmar/", "host/app/Result.h", "host/front_end/"}, true, false, true},
    {"host/", {"sdk/", "kelmar/"}, true, false},
    {"quarn/words/", {"sdk/"}, true, false},
    {"quarn/terminal/", {"quarn/words/"}, true, false},
    {"quarn/session/", {"host/front_end/", "quarn/terminal/", "quarn/words/"}, true, false},
    {"quarn/scripts/", {"sdk/", "host/front_end/", "quarn/words/"}, true, false},
    {"quarn/runs/", {"quarn/scripts/", "quarn/session/", "quarn/words/"}, true, false},
    {"quarn/reports/",
     {"host/front_end/", "quarn/scripts/", "quarn/session/", "quarn/words/"},
     true,
     false},
    {"quarn/console/",
     {"sdk/", "host/front_end/", "quarn/session/", "quarn/terminal/", "quarn/words/"},
     true,
     false},
    {"quarn/arguments/",
     {"quarn/console/", "quarn/reports/", "quarn/runs/", "quarn/scripts/", "quarn/words/"},
     true,
     false},
    {"quarn/", {"sdk/", "host/front_end/"}, true, false},
    {"desktop/", {"sdk/", "host/front_end/"}, true, false},
    {"examples/", {"sdk/", "kelmar/"}, true, false},
};

const Rule* ruleFor(std::string_view file) {
    const auto rule = std::ranges::find_if(
        RULES, [&](const Rule& candidate) { return file.starts_with(candidate.place); });
    return rule == std::end(RULES) ? nullptr : &*rule;
}

/// The language's own headers have neither a folder nor an ending.
bool isStandardHeader(std::string_view path) {
    return path.find_first_of("/.") == std::string_view::npos;
}

bool isCocoaFramework(std::string_view path) {
    return path.starts_with("AppKit/") || path.starts_with("Foundation/");
}

/// Objective-C++, which the rest of the project is built without.
bool isCocoaHeader(std::string_view path) {
    return path.starts_with("sdk/cocoa/") || path.starts_with("host/cocoa/") ||
           path == "zoetrix/ui/QXTurnTableDialogController.h";
}

/// Only the one file that defines the plug-in's global objects stands above its folders.
bool isAboveTheFolders(std::string_view path) {
    return path.starts_with(ALL_OF_ZOETRIX) &&
           path.find('/', ALL_OF_ZOETRIX.size()) == std::string_view::npos;
}

bool isSource(const fs::path& path) {
    const auto ending = path.extension();
    return ending == ".h" || ending == ".cpp" || ending == ".mm";
}

std::string contentOf(const fs::path& path) {
    std::ostringstream content;
    content << std::ifstream(path).rdbuf();
    return content.str();
}

std::string topFolder(std::string_view place) {
    return std::string(place.substr(0, place.find('/')));
}

void addBreaches(const fs::path& root, const fs::path& path, std::vector<std::string>& breaches) {
    const std::string file = path.lexically_relative(root).generic_string();
    for (const Include& include : includesOf(contentOf(path))) {
        if (!isAllowed(file, include)) {
            breaches.push_back(file + ":" + std::to_string(include.line) + ": may not include " +
                               include.path);
        }
    }
}

} // namespace

std::vector<Include> includesOf(const std::string& source) {
    static const std::regex pattern(R"(^\s*#\s*(?:include|import)\s*([<"])([^>"]+)[>"])");
    std::vector<Include> includes;
    std::istringstream lines(source);
    std::string text;
    for (int line = 1; std::getline(lines, text); ++line) {
        if (std::smatch match; std::regex_search(text, match, pattern)) {
            includes.push_back({line, match[1] == "\"", match[2]});
        }
    }
    return includes;
}

bool isAllowed(const std::string& file, const Include& include) {
    const Rule* const rule = ruleFor(file);
    if (rule == nullptr) {
        return false;
    }
    if (!include.quoted && isCocoaFramework(include.path)) {
        return rule->knows_cocoa;
    }
    if (!include.quoted) {
        return !rule->standard_library_only || isStandardHeader(include.path);
    }
    if (isAboveTheFolders(include.path) || (isCocoaHeader(include.path) && !rule->knows_cocoa)) {
        return false;
    }
    if (rule->knows_itself && include.path.starts_with(rule->place)) {
        return true;
    }
    return std::ranges::any_of(rule->allowed, [&](std::string_view place) {
        return !place.empty() && include.path.starts_with(place);
    });
}

std::vector<std::string> breachesBelow(const std::filesystem::path& root) {
    std::vector<std::string> folders;
    for (const Rule& rule : RULES) {
        folders.push_back(topFolder(rule.place));
    }
    std::ranges::sort(folders);
    folders.erase(std::unique(folders.begin(), folders.end()), folders.end());

    std::vector<std::string> breaches;
    for (const std::string& folder : folders) {
        if (!fs::is_directory(root / folder)) {
            continue;
        }
        for (const auto& entry : fs::recursive_directory_iterator(root / folder)) {
            if (entry.is_regular_file() && isSource(entry.path())) {
                addBreaches(root, entry.path(), breaches);
            }
        }
    }
    std::ranges::sort(breaches);
    return breaches;
}

} // namespace layers
