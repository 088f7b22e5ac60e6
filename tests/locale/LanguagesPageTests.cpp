#include "tests/locale/Tables.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <fstream>
#include <iterator>

namespace locale_rules {
namespace {

std::string pageText() {
    std::ifstream stream(std::filesystem::path(QUARN_SOURCE_DIR) / "docs/languages.md");
    return {std::istreambuf_iterator<char>(stream), {}};
}

/// Whether a German table has the text under this number.
bool isInGermanTables(const std::string& space, const std::string& number,
                      const std::string& text) {
    return std::ranges::any_of(modules(), [&](const Module& module) {
        return std::ranges::any_of(module.tables.front().texts, [&](const auto& entry) {
            return nameOf(entry.first.first) == space &&
                   std::to_string(entry.first.second) == number && entry.second == text;
        });
    });
}

TEST(LanguagesPage, ShowsATableAsItIs) {
    const std::string page = pageText();
    const std::size_t begin = page.find("```json\n") + 8;
    const auto table = nlohmann::json::parse(page.substr(begin, page.find("```", begin) - begin));
    ASSERT_EQ(table.size(), 3U);
    for (const auto& [space, texts] : table.items())
        for (const auto& [number, text] : texts.items())
            EXPECT_TRUE(isInGermanTables(space, number, text)) << space << " " << number;
}

TEST(LanguagesPage, NamesEveryFolderOfTables) {
    for (const Module& module : modules())
        EXPECT_NE(pageText().find("`" + module.folder.filename().string() + "/locale/`"),
                  std::string::npos)
            << module.folder;
}

} // namespace
} // namespace locale_rules
