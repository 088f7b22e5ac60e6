#include "host/app/CommandLine.h"

#include <gtest/gtest.h>

#include <vector>

namespace quarn {
namespace {

std::vector<std::wstring> textsOf(const std::deque<CommandWord>& words) {
    std::vector<std::wstring> texts;
    for (const CommandWord& word : words)
        texts.push_back(word.text);
    return texts;
}

using Texts = std::vector<std::wstring>;

TEST(CommandLine, WordsAreSplitAtBlanksAndTabs) {
    EXPECT_EQ(textsOf(splitWords(L"  Open \t house.obj  ").value()),
              (Texts{L"Open", L"house.obj"}));
}

TEST(CommandLine, QuotesGroupAlsoInsideAWord) {
    EXPECT_EQ(textsOf(splitWords(LR"("a b" c="d e"f "")").value()),
              (Texts{L"a b", L"c=d ef", L""}));
}

TEST(CommandLine, OnlyAWordThatBeginsWithAQuoteIsLiteral) {
    const auto words = splitWords(LR"("_Enter" _En"ter")").value();
    EXPECT_TRUE(words[0].quoted);
    EXPECT_FALSE(words[1].quoted);
}

TEST(CommandLine, AnOpenQuoteIsRefusedAndShown) {
    const auto words = splitWords(LR"(Open "house)");
    ASSERT_FALSE(words);
    EXPECT_EQ(words.message(), "A double quote is not closed in: Open \"house");
}

TEST(CommandLine, PrefixesStandInAnyOrderBeforeTheName) {
    for (const wchar_t* line :
         {L"_-Open x", L"-_Open x", L"!_-Open x", L"! _-Open x", L"!! -_Open x"}) {
        const auto parsed = parseCommandLine(line);
        ASSERT_TRUE(parsed);
        EXPECT_EQ(parsed.value().name, L"Open");
        EXPECT_TRUE(parsed.value().english_name);
        EXPECT_TRUE(parsed.value().without_dialogs);
        EXPECT_EQ(textsOf(parsed.value().words), Texts{L"x"});
    }
}

TEST(CommandLine, WithoutPrefixesNothingIsAskedFor) {
    const auto parsed = parseCommandLine(L"Open _x -y");
    EXPECT_FALSE(parsed.value().english_name);
    EXPECT_FALSE(parsed.value().without_dialogs);
    EXPECT_EQ(textsOf(parsed.value().words), (Texts{L"_x", L"-y"}));
}

TEST(CommandLine, ALineOfBlanksOrExclamationMarksIsBlank) {
    for (const wchar_t* line : {L"", L"   ", L"!", L" ! "})
        EXPECT_TRUE(parseCommandLine(line).value().isBlank());
}

TEST(CommandLine, APrefixWithoutANameIsRefused) {
    for (const wchar_t* line : {L"_", L"-", L"_ Open", L"! -"})
        EXPECT_FALSE(parseCommandLine(line));
}

} // namespace
} // namespace quarn
