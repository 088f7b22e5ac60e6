#include "import/text/Words.h"

#include <gtest/gtest.h>

#include <cstdint>

namespace quarn {
namespace {

TEST(Words, BlanksPartWordsAndTheLinesReturnIsOne) {
    std::string_view rest = "  v\t1.5  x\r";
    EXPECT_EQ(takeWord(rest), "v");
    EXPECT_EQ(takeWord(rest), "1.5");
    EXPECT_EQ(takeWord(rest), "x");
    EXPECT_EQ(takeWord(rest), "");
}

TEST(Words, NumbersAreTakenWithTheirSigns) {
    std::string_view rest = "+1.5 -2e3 \t.25\r";
    EXPECT_EQ(takeNumber<double>(rest), 1.5);
    EXPECT_EQ(takeNumber<double>(rest), -2000.0);
    EXPECT_EQ(takeNumber<double>(rest), 0.25);
    EXPECT_EQ(takeNumber<double>(rest), std::nullopt);
    std::string_view signs = "+-1";
    EXPECT_EQ(takeNumber<double>(signs), std::nullopt);
}

TEST(Words, ANumberTooLargeIsInfiniteAndOneTooSmallZero) {
    std::string_view rest = "1e999 -1e999 1e-999 1E-999 -1e-999";
    EXPECT_TRUE(std::isinf(*takeNumber<float>(rest)));
    EXPECT_TRUE(std::isinf(*takeNumber<float>(rest)));
    EXPECT_EQ(takeNumber<float>(rest), 0.0F);
    EXPECT_EQ(takeNumber<float>(rest), 0.0F);
    EXPECT_EQ(takeNumber<float>(rest), 0.0F);
}

TEST(Words, AWordThatOnlyBeginsWithANumberIsNoneAndStays) {
    std::string_view rest = " 12x 7";
    EXPECT_EQ(takeNumber<std::int64_t>(rest), std::nullopt);
    EXPECT_EQ(takeWord(rest), "12x");
    EXPECT_EQ(takeNumber<std::int64_t>(rest), 7);
    std::string_view corner = "3/5";
    EXPECT_EQ(takeLeadingNumber<std::int64_t>(corner), 3);
    EXPECT_EQ(corner, "/5");
}

TEST(Words, AWholeNumberOutOfItsTypesRangeIsNone) {
    std::string_view rest = "4294967296";
    EXPECT_EQ(takeNumber<std::uint32_t>(rest), std::nullopt);
    EXPECT_EQ(takeWord(rest), "4294967296");
}

TEST(Words, AQuotedWordIsShortAndHarmless) {
    EXPECT_EQ(quotedWord("12x"), "'12x'");
    EXPECT_EQ(quotedWord("\x1b[2J"), "'?[2J'");
    EXPECT_EQ(quotedWord(std::string(60, 'a')), "'" + std::string(40, 'a') + "...'");
}

} // namespace
} // namespace quarn
