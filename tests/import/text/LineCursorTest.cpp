#include "import/text/LineCursor.h"

#include <gtest/gtest.h>

#include <string>

namespace quarn {
namespace {

TEST(LineCursor, HandsOutEachLineWithItsNumberAndKnowsWhetherTheLastWasEnded) {
    LineCursor lines("one\r\n\nthree");
    std::string_view line;
    ASSERT_TRUE(lines.next(line));
    EXPECT_EQ(line, "one\r");
    EXPECT_TRUE(lines.wasEnded());
    ASSERT_TRUE(lines.next(line));
    EXPECT_EQ(line, "");
    ASSERT_TRUE(lines.next(line));
    EXPECT_EQ(line, "three");
    EXPECT_EQ(lines.number(), 3U);
    EXPECT_FALSE(lines.wasEnded());
    EXPECT_FALSE(lines.next(line));
}

TEST(LineCursor, AReturnEndsLinesOnlyWhereNoFeedFollowsIt) {
    EXPECT_EQ(lineBreakOf("ply\rformat ascii 1.0\r"), '\r');
    EXPECT_EQ(lineBreakOf("ply\r\nformat"), '\n');
    EXPECT_EQ(lineBreakOf("ply\r\r\nformat"), '\n');
    EXPECT_EQ(lineBreakOf("ply\nformat\r"), '\n');
    EXPECT_EQ(lineBreakOf("ply"), '\n');
    EXPECT_EQ(lineBreakOf("ply\r"), '\n');
}

TEST(LineCursor, PartsEndBetweenLinesAndAreTheTextTogether) {
    std::string text;
    for (int i = 0; i < 500; ++i)
        text += std::string(static_cast<std::size_t>(i) % 23, 'x') + '\n';
    text += "without an end";
    for (const std::size_t bytes : {1, 7, 64, 5000, 100'000}) {
        std::string together;
        std::uint64_t lines = 0;
        for (const std::string_view part : partsOfLines(text, bytes)) {
            EXPECT_FALSE(part.empty());
            together += part;
            lines += countLines(part);
            EXPECT_TRUE(part.back() == '\n' || together == text);
        }
        EXPECT_EQ(together, text);
        EXPECT_EQ(lines, 501U);
    }
}

TEST(LineCursor, ALineIsNumberedByTheBreaksBeforeIt) {
    const std::string_view text = "a\nbc\n\nd";
    EXPECT_EQ(lineNumberAt(text, text.data()), 1U);
    EXPECT_EQ(lineNumberAt(text, text.data() + 3), 2U);
    EXPECT_EQ(lineNumberAt(text, text.data() + 6), 4U);
    EXPECT_EQ(lineNumberAt(text, text.data() + 7), 4U);
}

} // namespace
} // namespace quarn
