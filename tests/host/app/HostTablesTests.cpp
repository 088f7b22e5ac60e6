#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <regex>
#include <set>
#include <string>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;

const fs::path SOURCE = QUARN_SOURCE_DIR;

std::string textOf(const fs::path& file) {
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

std::vector<fs::path> tables() {
    std::vector<fs::path> files;
    for (const auto& entry : fs::directory_iterator(SOURCE / "host/locale"))
        files.push_back(entry.path());
    return files;
}

/// The text numbers of the host's own range that its sources write out.
std::set<std::string> numbersInSources() {
    std::set<std::string> numbers;
    const std::regex number(R"(\b4[1-3]\d{3}\b)");
    for (const auto& entry : fs::recursive_directory_iterator(SOURCE / "host")) {
        if (entry.path().extension() != ".cpp")
            continue;
        const std::string text = textOf(entry.path());
        for (std::sregex_iterator found(text.begin(), text.end(), number), end; found != end;
             ++found)
            numbers.insert(found->str());
    }
    return numbers;
}

std::set<std::string> numbersIn(const nlohmann::json& table) {
    std::set<std::string> numbers;
    for (const auto& [space, texts] : table.items()) {
        for (const auto& [number, text] : texts.items())
            numbers.insert(number);
    }
    return numbers;
}

TEST(HostTables, HoldEveryTextThatTheHostsSourcesNumber) {
    const std::set<std::string> wanted = numbersInSources();
    ASSERT_GT(wanted.size(), 10U);
    ASSERT_FALSE(tables().empty());
    for (const fs::path& file : tables()) {
        const std::set<std::string> there = numbersIn(nlohmann::json::parse(textOf(file)));
        for (const std::string& number : wanted)
            EXPECT_TRUE(there.contains(number)) << file << " lacks " << number;
    }
}

TEST(HostTables, HoldTheSameNumbersInEveryLanguage) {
    const auto first = nlohmann::json::parse(textOf(tables().front()));
    for (const fs::path& file : tables()) {
        const auto table = nlohmann::json::parse(textOf(file));
        for (const char* space : {"strings", "option_names", "option_values"})
            EXPECT_EQ(numbersIn({{space, table[space]}}), numbersIn({{space, first[space]}}))
                << file;
    }
}

/// The plug-in compares its texts for "Rendered", "X-Ray" and "Wireframe" with the host's names.
TEST(HostTables, NameTheDisplayModesAsTheAnimationPlugInDoesInEachOfItsLanguages) {
    int compared = 0;
    for (const auto& entry : fs::directory_iterator(SOURCE / "zoetrix/locale")) {
        const auto plug_in = nlohmann::json::parse(textOf(entry.path()))["strings"];
        const fs::path file = SOURCE / "host/locale" / entry.path().filename();
        ASSERT_TRUE(fs::exists(file)) << file;
        const auto host = nlohmann::json::parse(textOf(file))["strings"];
        for (const char* number : {"19746", "20120", "32015"}) {
            EXPECT_EQ(plug_in[number], host[number]) << entry.path() << " " << number;
            ++compared;
        }
    }
    EXPECT_GE(compared, 3);
}

} // namespace
} // namespace quarn::test
