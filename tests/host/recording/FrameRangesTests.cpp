#include "host/recording/FrameRanges.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

std::vector<int> framesOf(std::string_view text) {
    const auto read = parseFrameRanges(text);
    EXPECT_TRUE(read.ok()) << text;
    std::vector<int> frames;
    for (const FrameSet::Range& range : read.value().ranges())
        for (int frame = range.first; frame <= range.last; ++frame)
            frames.push_back(frame);
    EXPECT_EQ(static_cast<int>(frames.size()), read.value().count());
    return frames;
}

TEST(FrameRanges, CountBothEndsAndEveryStep) {
    using testing::ElementsAre;
    EXPECT_THAT(framesOf("0-3"), ElementsAre(0, 1, 2, 3));
    EXPECT_THAT(framesOf("12-12"), ElementsAre(12));
    EXPECT_THAT(framesOf("20-30:4"), ElementsAre(20, 24, 28));
    EXPECT_THAT(framesOf("0-1,20-24:2,7-7"), ElementsAre(0, 1, 7, 20, 22, 24));
    EXPECT_THAT(framesOf("5-9,7-11"), ElementsAre(5, 6, 7, 8, 9, 10, 11));
    EXPECT_THAT(framesOf("none"), testing::IsEmpty());
}

TEST(FrameRanges, ABareNumberIsToldAsThat) {
    for (const char* text : {"7", "0-3,7", "100"}) {
        const auto read = parseFrameRanges(text);
        ASSERT_FALSE(read.ok()) << text;
        EXPECT_THAT(read.message(), testing::HasSubstr("bare number"));
    }
}

TEST(FrameRanges, WhatIsNoRangeIsToldWithItsWords) {
    for (const char* text :
         {"", "-", "a-b", "3-", "-3", "5-3", "0-9:0", "0-9:", "0-9:x", "0-9,,1-2", "0-9,", "1-2-3",
          "0-10000000", "0-99999999999999999999", " 0-9", "0-9:-1", "None"}) {
        const auto read = parseFrameRanges(text);
        ASSERT_FALSE(read.ok()) << text;
        EXPECT_THAT(read.message(), testing::HasSubstr("no range of frames")) << text;
    }
}

} // namespace
} // namespace quarn::test
