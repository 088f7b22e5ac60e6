#include "host/recording/FrameNames.h"
#include "host/recording/FrameSet.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using Range = FrameSet::Range;

std::vector<Range> rangesOf(const FrameSet& frames) {
    return {frames.ranges().begin(), frames.ranges().end()};
}

TEST(FrameNames, NumberIsWrittenWithAtLeastThreeDigits) {
    const FrameNames names{"Walk", "png"};
    EXPECT_EQ(names.fileName(0), "Walk000.png");
    EXPECT_EQ(names.fileName(12), "Walk012.png");
    EXPECT_EQ(names.fileName(1234), "Walk1234.png");
    for (const int frame : {0, 7, 99, 999, 1000, 123456})
        EXPECT_EQ(names.frameOf(names.fileName(frame)), frame);
}

TEST(FrameNames, OtherFilesAreNoFrames) {
    const FrameNames names{"Walk", "png"};
    for (const char* name :
         {"Walk12.png", "Walk0012.png", "Walk012.jpg", "walk012.png", "Walk.png", "Walk01x.png",
          "Walk-01.png", "Walk012.png.part", "png", "", "Walk99999999999.png", "MyWalk012.png"})
        EXPECT_FALSE(names.frameOf(name)) << name;
}

TEST(FrameNames, ANameThatEndsInDigitsKeepsThemApartFromTheNumber) {
    const FrameNames names{"tower2", "jpg"};
    EXPECT_EQ(names.frameOf("tower2000.jpg"), 0);
    EXPECT_FALSE(names.frameOf("tower200.jpg"));
}

TEST(FrameSet, FramesThatFollowEachOtherAreOneRange) {
    FrameSet frames;
    for (const int frame : {3, 5, 4, 9, 0, 1})
        frames.add(frame);
    EXPECT_THAT(rangesOf(frames), ElementsAre(Range{0, 1}, Range{3, 5}, Range{9, 9}));
    frames.add(Range{2, 8});
    EXPECT_THAT(rangesOf(frames), ElementsAre(Range{0, 9}));
    frames.add(4);
    EXPECT_THAT(rangesOf(frames), ElementsAre(Range{0, 9}));
}

TEST(FrameSet, HoldsWhatWasAddedAndNothingElse) {
    FrameSet frames = FrameSet::firstOf(3);
    frames.add(Range{10, 2147483647});
    for (const int frame : {0, 2, 10, 2147483647})
        EXPECT_TRUE(frames.has(frame)) << frame;
    for (const int frame : {-1, 3, 9})
        EXPECT_FALSE(frames.has(frame)) << frame;
    EXPECT_TRUE(FrameSet::firstOf(0).isEmpty());
}

} // namespace
} // namespace quarn::test
