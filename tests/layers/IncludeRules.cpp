#include "tests/layers/IncludeRules.h"

#include "tests/layers/Floors.h"

#include <algorithm>
#include <fstream>
#include <regex>
#include <span>
#include <sstream>
#include <string_view>

namespace layers {
namespace {

namespace fs = std::filesystem;

constexpr std::string_view ALL_OF_ZOETRIX = "zoetrix/";

const Room* roomOf(std::string_view file) {
    const std::span<const Room> rooms = floors();
    const auto room = std::ranges::find_if(
        rooms, [&](const Room& candidate) { return file.starts_with(candidate.place); });
    return room == rooms.end() ? nullptr : &*room;
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
    const Room* const room = roomOf(file);
    if (room == nullptr) {
        return false;
    }
    using enum Room::Libraries;
    const bool knows_all = room->libraries == any || room->libraries == any_and_cocoa;
    const bool knows_cocoa =
        room->libraries == standard_and_cocoa || room->libraries == any_and_cocoa;
    if (!include.quoted && isCocoaFramework(include.path)) {
        return knows_cocoa;
    }
    if (!include.quoted) {
        return knows_all || isStandardHeader(include.path);
    }
    if (isAboveTheFolders(include.path) || (isCocoaHeader(include.path) && !knows_cocoa)) {
        return false;
    }
    const auto leads_there = [&](std::string_view place) {
        return include.path.starts_with(place);
    };
    return (room->knows_itself && leads_there(room->place)) ||
           std::ranges::any_of(room->sees, leads_there) ||
           std::ranges::any_of(room->neighbours, leads_there);
}

std::vector<std::string> breachesBelow(const std::filesystem::path& root) {
    std::vector<std::string> folders;
    for (const Room& room : floors()) {
        folders.push_back(topFolder(room.place));
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
