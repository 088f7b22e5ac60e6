#include "quarn/Columns.h"
#include "quarn/PromptText.h"

#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using program::inColumns;
using program::promptText;

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

} // namespace
} // namespace quarn::test
