#include "tests/locale/Tables.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <fstream>
#include <iterator>

namespace locale_rules {
namespace {

constexpr Space SPACES[] = {Space::strings, Space::option_names, Space::option_values};

void readSpace(const nlohmann::ordered_json& texts, Space space, Table& table) {
    int last = 0;
    for (const auto& [key, text] : texts.items()) {
        const int number = std::atoi(key.c_str());
        if (number <= last)
            table.faults.push_back(key + " does not stand behind a smaller number");
        last = number;
        table.texts[{space, number}] = text.is_string() ? text.get<std::string>() : "";
    }
}

/// A number that stands twice in one object is lost in reading, so the colons are counted.
void countNumbers(const std::string& json, Table& table) {
    std::size_t numbers = 0;
    for (std::size_t at = json.find("\": \""); at != std::string::npos;
         at = json.find("\": \"", at + 1))
        ++numbers;
    if (numbers != table.texts.size())
        table.faults.push_back("it has " + std::to_string(numbers) + " lines of texts but " +
                               std::to_string(table.texts.size()) + " numbers");
}

void addOnce(std::vector<std::string>& texts, const std::string& text) {
    if (std::ranges::find(texts, text) == texts.end())
        texts.push_back(text);
}

Module readModule(const std::filesystem::path& folder) {
    Module module{folder, textUsesBelow(folder), {}, {}, {}};
    for (const char* language : LANGUAGES)
        module.tables.push_back(readTable(folder / "locale" / (std::string(language) + ".json")));
    for (const TextUse& use : module.uses)
        if (use.english)
            addOnce(use.space ? module.looked_up[{*use.space, use.number}]
                              : module.listed[use.number],
                    *use.english);
    return module;
}

std::vector<Module> readModules() {
    std::vector<Module> read;
    for (const auto& entry : std::filesystem::directory_iterator(QUARN_SOURCE_DIR))
        if (std::filesystem::is_directory(entry.path() / "locale") &&
            entry.path().filename() != "tests")
            read.push_back(readModule(entry.path()));
    return read;
}

} // namespace

const char* nameOf(Space space) {
    constexpr const char* NAMES[] = {"strings", "option_names", "option_values"};
    return NAMES[static_cast<std::size_t>(space)];
}

Table readTable(const std::filesystem::path& file) {
    Table table{file, file.stem().string(), {}, {}};
    std::ifstream stream(file, std::ios::binary);
    const std::string json{std::istreambuf_iterator<char>(stream), {}};
    const auto parsed = nlohmann::ordered_json::parse(json, nullptr, false);
    if (!parsed.is_object()) {
        table.faults.push_back("it is no JSON object in UTF-8");
        return table;
    }
    for (const Space space : SPACES)
        if (const auto found = parsed.find(nameOf(space)); found != parsed.end())
            readSpace(*found, space, table);
    countNumbers(json, table);
    return table;
}

const std::vector<std::string>& Module::englishOf(const TextKey& key) const {
    static const std::vector<std::string> none;
    if (const auto found = looked_up.find(key); found != looked_up.end())
        return found->second;
    const auto found = listed.find(key.second);
    return found == listed.end() ? none : found->second;
}

const std::vector<Module>& modules() {
    static const std::vector<Module> read = readModules();
    return read;
}

} // namespace locale_rules
