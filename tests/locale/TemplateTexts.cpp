#include "tests/locale/TemplateTexts.h"

#include <nlohmann/json.hpp>

#include <algorithm>

namespace locale_rules {
namespace {

using Json = nlohmann::ordered_json;

/// The line in which a number stands first; 0 when it does not.
int lineOf(const std::string& json, int number) {
    const std::size_t place = json.find("\"id\": " + std::to_string(number));
    if (place == std::string::npos)
        return 0;
    const auto end = json.begin() + static_cast<std::ptrdiff_t>(place);
    return 1 + static_cast<int>(std::count(json.begin(), end, '\n'));
}

void addUses(const Json& part, const std::string& json, const std::filesystem::path& file,
             std::vector<TextUse>& uses) {
    if (part.is_object() && part.contains("text") && part.contains("id")) {
        const int number = part["id"].get<int>();
        uses.push_back(
            {number, Space::strings, part["text"].get<std::string>(), file, lineOf(json, number)});
    } else if (part.is_structured()) {
        for (const Json& inner : part)
            addUses(inner, json, file, uses);
    }
}

} // namespace

std::vector<TextUse> templateTextUses(const std::string& json, const std::filesystem::path& file) {
    std::vector<TextUse> uses;
    addUses(Json::parse(json, nullptr, false), json, file, uses);
    return uses;
}

} // namespace locale_rules
