#include "quarn/console/PromptText.h"
#include "quarn/terminal/Columns.h"

#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using program::inColumns;
using program::promptText;
using program::wrappedPrompt;

Question questionOf(Question::Kind kind) {
    Question question;
    question.kind = kind;
    question.prompt = L"Direction";
    question.options = {{L"Clockwise", L"Rechts", L""}, {L"Frames", L"Bilder", L"12"}};
    return question;
}

TEST(PromptText, ShowsDefaultAndOptionsAsTheyAreTyped) {
    Question question = questionOf(Question::Kind::integer);
    EXPECT_EQ(promptText(question), L"Direction ( Rechts Bilder=12 ): ");
    question.default_answer = KM_wString(L"Rechts");
    EXPECT_EQ(promptText(question), L"Direction <Rechts> ( Rechts Bilder=12 ): ");
    question.kind = Question::Kind::string;
    EXPECT_EQ(promptText(question), L"Direction <Rechts> ( [Rechts] [Bilder=12] ): ");
    question.options.clear();
    question.default_answer = KM_wString();
    EXPECT_EQ(promptText(question), L"Direction: ");
}

TEST(Columns, GoDownFirstAndFillTheWidth) {
    // Three columns of 3 and two gaps of 2 make 13.
    EXPECT_EQ(inColumns({L"a", L"bbb", L"c", L"d", L"e"}, 13), "a    c    e\nbbb  d\n");
    EXPECT_EQ(inColumns({L"a", L"bbb", L"c"}, 12), "a    c\nbbb\n");
    EXPECT_EQ(inColumns({L"größe", L"b"}, 1), "größe\nb\n");
    EXPECT_EQ(inColumns({}, 80), "");
}

TEST(Columns, WideNamesStandUnderEachOther) {
    // Two columns of 6 and a gap of 2 make 14.
    EXPECT_EQ(inColumns({L"线框", L"abc", L"半透明", L"d"}, 14), "线框    半透明\nabc     d\n");
    EXPECT_EQ(inColumns({L"线框", L"abc", L"半透明"}, 13), "线框\nabc\n半透明\n");
    // A mark over a letter takes no column of its own, a halfwidth letter takes one.
    EXPECT_EQ(inColumns({L"o\u0308", L"abc", L"ﾜｲﾔ", L"d"}, 8), "o\u0308    ﾜｲﾔ\nabc  d\n");
}

TEST(PromptText, WideWordsBreakWhereTheirColumnsDo) {
    // 60 columns leave 36 for the prompt: three of these words take 30, and four would take 40.
    const std::wstring word = L"线框线框线"; // ten columns
    const std::wstring prompt = word + L" " + word + L" " + word + L" " + word;
    EXPECT_EQ(wrappedPrompt(prompt, 60), word + L" " + word + L" " + word + L" \n  " + word);
    EXPECT_EQ(wrappedPrompt(word + L" " + word, 60), word + L" " + word);
}

} // namespace
} // namespace quarn::test
