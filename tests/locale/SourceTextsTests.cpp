#include "tests/locale/SourceTexts.h"

#include <gtest/gtest.h>

namespace locale_rules {
namespace {

TextUse onlyUse(std::string_view source) {
    const std::vector<TextUse> uses = textUses(source, "file.cpp");
    EXPECT_EQ(uses.size(), 1U) << source;
    return uses.empty() ? TextUse{} : uses.front();
}

TEST(SourceTexts, EachLookUpHasItsSpace) {
    EXPECT_EQ(onlyUse(R"(QnLocalizeString(L"A", 41001))").space, Space::strings);
    EXPECT_EQ(onlyUse(R"(localized(L"A", 41001))").space, Space::strings);
    EXPECT_EQ(onlyUse(R"(QnLocalizeCommandOptionName(L"A", 41001))").space, Space::option_names);
    EXPECT_EQ(onlyUse(R"(get.Add(QnLocalizeCommandOptionValue(L"A", 41001), f(1)))").space,
              Space::option_values);
    EXPECT_EQ(onlyUse(R"(constexpr Row ROWS[] = {{L"A", 41001}};)").space, std::nullopt);
}

TEST(SourceTexts, LiteralsSideBySideAreOneText) {
    EXPECT_EQ(onlyUse("f(L\"One \"  // why\n  L\"line\\n\",\n 41001)").english, "One line\n");
    EXPECT_EQ(onlyUse(R"(f(L"Say \"so\" \\", 41001))").english, R"(Say "so" \)");
}

TEST(SourceTexts, AConstantOfTheFileStandsForItsText) {
    EXPECT_EQ(onlyUse(R"(const wchar_t nothing[] = L"None"; f(nothing, 41001);)").english, "None");
    EXPECT_EQ(onlyUse(R"(auto* nothing = L"None"; f(nothing, 41001);)").english, "None");
}

TEST(SourceTexts, ALookUpWhoseTextIsNowhereIsStillAUse) {
    const TextUse use = onlyUse("\n\nQnLocalizeString(which ? a : b, 41001)");
    EXPECT_EQ(use.number, 41001);
    EXPECT_EQ(use.english, std::nullopt);
    EXPECT_EQ(use.line, 3);
}

TEST(SourceTexts, OtherNumbersAndCommentsAreNone) {
    for (const char* source :
         {R"(// QnLocalizeString(L"A", 41001))", R"(/* f(L"A", 41001) */ int a;)",
          R"(f(L"A", 4100))", R"(f(L"A", 410011))", R"(f("A", 41001))", "size(width, 16384)",
          R"(f(L"A", 0x410))", R"(R"x(f(L"A", 41001))x")", "f(L'a', 41001)"})
        EXPECT_TRUE(textUses(source, "file.cpp").empty()) << source;
}

} // namespace
} // namespace locale_rules
