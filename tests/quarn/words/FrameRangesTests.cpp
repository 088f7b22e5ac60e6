#include "quarn/words/FrameRanges.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::program {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

std::vector<int> framesOf(const std::string& text, int count = 40) {
    const FrameRangesReading reading = readFrameRanges("--frames", text);
    EXPECT_EQ(reading.refusal, "") << text;
    std::vector<int> frames;
    for (int frame = 0; frame < count; ++frame)
        if (reading.ranges.hold(frame))
            frames.push_back(frame);
    return frames;
}

std::string refusalOf(const std::string& text) {
    return readFrameRanges("--frames", text).refusal;
}

TEST(FrameRanges, HoldBothEndsAndWhatTheStepMeets) {
    EXPECT_THAT(framesOf("3-6"), ElementsAre(3, 4, 5, 6));
    EXPECT_THAT(framesOf("12-12"), ElementsAre(12));
    EXPECT_THAT(framesOf("20-31:5"), ElementsAre(20, 25, 30));
    EXPECT_THAT(framesOf("8-9,0-1,30-34:2"), ElementsAre(0, 1, 8, 9, 30, 32, 34));
    EXPECT_THAT(framesOf("0-3,2-5"), ElementsAre(0, 1, 2, 3, 4, 5));
}

TEST(FrameRanges, AreAllWhereNoneIsNamed) {
    EXPECT_TRUE(FrameRanges().areAll());
    EXPECT_TRUE(FrameRanges().hold(123456));
    EXPECT_EQ(FrameRanges().text(), "");
    EXPECT_THAT(FrameRanges({{2, 4, 1}}).among({0, 2, 3, 9}), ElementsAre(2, 3));
}

TEST(FrameRanges, ReadBackFromTheirText) {
    for (const char* text : {"0-9,20-30:2", "5-5", "0-2147483647:2147483647"})
        EXPECT_EQ(readFrameRanges("--frames", text).ranges.text(), text);
    EXPECT_EQ(readFrameRanges("--frames", "007-009:1").ranges.text(), "7-9");
}

TEST(FrameRanges, BareNumberIsRefusedAsItCountsFramesElsewhere) {
    EXPECT_EQ(refusalOf("12"),
              "--frames takes ranges such as 0-9,20-30:2; one frame is 12-12. A number alone says "
              "how many frames, where an animation is made.");
    EXPECT_THAT(refusalOf("0-9,12"), HasSubstr("one frame is 12-12"));
}

TEST(FrameRanges, RefusalNamesWhatIsWrong) {
    EXPECT_EQ(refusalOf("0-3,9-3"),
              "--frames 9-3: 9 is behind 3; a range begins with its lower frame.");
    EXPECT_EQ(refusalOf("0-9:0"), "--frames 0-9:0: a step is at least 1, not 0.");
    EXPECT_EQ(refusalOf("0-2147483648"),
              "--frames 0-2147483648: 2147483648 is too large a number.");
    EXPECT_EQ(refusalOf("0-9:99999999999999999999"),
              "--frames 0-9:99999999999999999999: 99999999999999999999 is too large a number.");
    for (const char* text :
         {"", "x", "-3", "3-", "-1-3", "+1-3", "0-9,", ",", "0 - 9", "0-9, 20-30",
          "0-9:", "0-9:2:3", "0--9", "1e1-20", "0-9;11-12", "0x1-2"})
        EXPECT_THAT(refusalOf(text), HasSubstr("--frames takes ranges such as 0-9,20-30:2"))
            << text;
}

TEST(FrameLists, AreRunsAndOfManyOnlyHowTheyBegin) {
    EXPECT_EQ(frameListText({3}), "3");
    EXPECT_EQ(frameListText({3, 7, 8, 9}), "3 and 7-9");
    EXPECT_EQ(frameListText({0, 1, 5, 11, 12}), "0-1, 5 and 11-12");
    EXPECT_EQ(frameListText({0, 2, 4, 6, 8, 10, 12, 14, 16, 18}), "0, 2, 4, 6, 8, 10, 12, 14, ...");
    EXPECT_THAT(frameListText({}), IsEmpty());
}

} // namespace
} // namespace quarn::program
