#include "host/app/StringTables.h"

#include "ground/FileBytes.h"
#include "kelmar/KM_wString.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <charconv>
#include <cstdlib>
#include <set>
#include <span>

namespace quarn {

namespace {

/// More than any language has, and little enough to be read at once.
constexpr std::size_t MOST_BYTES = 1 << 24;

constexpr std::array<const char*, std::tuple_size_v<TextTable>> SPACE_NAMES = {
    "strings", "option_names", "option_values"};

/// The interface promises that a text lives as long as the program, also when its plug-in is gone.
const wchar_t* keepForever(std::wstring_view text) {
    static std::set<std::wstring, std::less<>> kept;
    return kept.emplace(text).first->c_str();
}

std::string languageOfEnvironment() {
    for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANG"}) {
        const char* value = std::getenv(variable);
        if (value && *value)
            return value;
    }
    return {};
}

bool isLanguageCharacter(char character) {
    return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z') ||
           character == '_' || character == '-';
}

bool readId(const std::string& text, int& id) {
    const char* end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, id);
    return error == std::errc() && stop == end && id > 0;
}

Result<std::map<int, std::wstring>> readSpace(const nlohmann::json& texts) {
    std::map<int, std::wstring> read;
    if (!texts.is_object())
        return Error{"its texts are not in an object"};
    for (const auto& [key, text] : texts.items()) {
        int id = 0;
        if (!readId(key, id))
            return Error{"\"" + key + "\" is no text number"};
        if (!text.is_string())
            return Error{"text " + key + " is no string"};
        read[id] = KM_wString::FromUtf8(text.get_ref<const std::string&>()).View();
    }
    return read;
}

Result<TextTable> readFile(const std::filesystem::path& file) {
    const Result<FileBytes> read = readFileBytes(file, MOST_BYTES);
    if (!read)
        return read.error();
    const std::span<const std::uint8_t> bytes = read.value().bytes();
    return readTextTable({reinterpret_cast<const char*>(bytes.data()), bytes.size()});
}

std::filesystem::path findTable(const std::vector<std::filesystem::path>& folders,
                                const std::vector<std::string>& languages) {
    for (const std::string& language : languages) {
        for (const std::filesystem::path& folder : folders) {
            std::error_code error;
            const std::filesystem::path file = folder / (language + ".json");
            if (std::filesystem::is_regular_file(file, error))
                return file;
        }
    }
    return {};
}

} // namespace

std::vector<std::string> wantedLanguages(std::string_view language) {
    std::string name = language.empty() ? languageOfEnvironment() : std::string(language);
    name.resize(std::min(name.find_first_of(".@"), name.size()));
    if (name.empty() || name == "C" || name == "POSIX" ||
        !std::ranges::all_of(name, isLanguageCharacter))
        return {};
    std::vector<std::string> languages;
    for (std::size_t end = name.size(); end != std::string::npos && end > 0;
         end = name.find_last_of("_-", end - 1))
        languages.push_back(name.substr(0, end));
    return languages;
}

Result<TextTable> readTextTable(std::string_view json) {
    const nlohmann::json parsed = nlohmann::json::parse(json, nullptr, false);
    if (!parsed.is_object())
        return Error{"it is no JSON object"};
    TextTable table;
    for (std::size_t space = 0; space < table.size(); ++space) {
        const auto found = parsed.find(SPACE_NAMES[space]);
        if (found == parsed.end())
            continue;
        Result<std::map<int, std::wstring>> texts = readSpace(*found);
        if (!texts)
            return texts.error();
        table[space] = std::move(texts.value());
    }
    return table;
}

StringTables::StringTables(std::string_view language) : m_languages(wantedLanguages(language)) {}

Result<void> StringTables::load(const std::string& owner,
                                const std::vector<std::filesystem::path>& folders) {
    remove(owner);
    const std::filesystem::path file = findTable(folders, m_languages);
    if (file.empty())
        return {};
    const Result<TextTable> read = readFile(file);
    if (!read)
        return Error{"The string table " + file.string() + " was left out: " + read.message()};
    Table& table = m_tables.emplace_back(Table{owner, {}});
    for (std::size_t space = 0; space < table.texts.size(); ++space)
        for (const auto& [id, text] : read.value()[space])
            table.texts[space][id] = keepForever(text);
    return {};
}

void StringTables::remove(const std::string& owner) {
    std::erase_if(m_tables, [&](const Table& table) { return table.owner == owner; });
}

const wchar_t* StringTables::find(TextSpace space, int id) const {
    for (const Table& table : m_tables) {
        const Texts& texts = table.texts[static_cast<std::size_t>(space)];
        if (const auto found = texts.find(id); found != texts.end())
            return found->second;
    }
    return nullptr;
}

} // namespace quarn
