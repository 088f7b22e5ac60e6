#include "quarn/farm/FrameChunks.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <numeric>

namespace quarn::program {
namespace {

using testing::Each;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::SizeIs;

constexpr int ENOUGH = 10000;

std::vector<int> frames(int count) {
    std::vector<int> all(static_cast<std::size_t>(count));
    std::iota(all.begin(), all.end(), 0);
    return all;
}

std::vector<std::string> texts(const Result<FrameChunks>& chunks) {
    std::vector<std::string> ranges;
    EXPECT_TRUE(chunks.ok()) << chunks.message();
    if (chunks.ok())
        for (const std::vector<int>& chunk : chunks.value())
            ranges.push_back(rangesText(chunk));
    return ranges;
}

TEST(FrameChunks, OfSoManyTasksDifferByOneFrame) {
    EXPECT_THAT(texts(shareOut(frames(10), {.tasks = 4}, {}, ENOUGH)),
                ElementsAre("0-1", "2-4", "5-6", "7-9"));
}

TEST(FrameChunks, AreNoMoreThanTheFrames) {
    EXPECT_THAT(texts(shareOut(frames(2), {.tasks = 40}, {}, ENOUGH)), ElementsAre("0-0", "1-1"));
}

TEST(FrameChunks, OfSoManyFramesLeaveTheRestToTheLast) {
    EXPECT_THAT(texts(shareOut(frames(10), {.chunk_frames = 4}, {}, ENOUGH)),
                ElementsAre("0-3", "4-7", "8-9"));
}

TEST(FrameChunks, HoldTheFramesThatAreMissingAlone) {
    EXPECT_THAT(texts(shareOut({3, 4, 5, 9, 11, 12}, {.tasks = 2}, {}, ENOUGH)),
                ElementsAre("3-5", "9-9,11-12"));
}

TEST(FrameChunks, TakeFiveMinutesWhereNobodySaysIt) {
    const auto chunks = shareOut(frames(1000), {}, {.frame_s = 10.0}, ENOUGH);
    ASSERT_TRUE(chunks.ok());
    EXPECT_THAT(chunks.value(), SizeIs(34)); // 1000 frames by 30
    EXPECT_THAT(chunks.value(), Each(SizeIs(testing::AnyOf(29, 30))));
}

TEST(FrameChunks, AreSoLongThatLoadingIsATwentieth) {
    const auto chunks = shareOut(frames(1000), {}, {.frame_s = 10.0, .loading_s = 60.0}, ENOUGH);
    ASSERT_TRUE(chunks.ok());
    EXPECT_THAT(chunks.value(), SizeIs(9)); // 19 times 60 s are 114 frames
}

TEST(FrameChunks, OfSlowFramesHaveOne) {
    EXPECT_THAT(texts(shareOut(frames(3), {}, {.frame_s = 4000.0}, ENOUGH)), SizeIs(3));
}

TEST(FrameChunks, FitIntoTheTimeLimit) {
    // Of 120 s, 10 are for loading and 10 for the warning: 100 s are 10 frames.
    const auto chunks =
        shareOut(frames(100), {.limit_s = 120.0}, {.frame_s = 10.0, .loading_s = 10.0}, ENOUGH);
    ASSERT_TRUE(chunks.ok());
    EXPECT_THAT(chunks.value(), SizeIs(10));
}

TEST(FrameChunks, AreRefusedWhereTheTimeLimitIsTooShortForTwoFrames) {
    const FrameCost cost{.frame_s = 25.0, .loading_s = 11.0};
    const auto refused = shareOut(frames(100), {.limit_s = 60.0}, cost, ENOUGH);
    ASSERT_FALSE(refused.ok());
    EXPECT_THAT(refused.message(), HasSubstr("--time"));
    EXPECT_TRUE(shareOut(frames(100), {.limit_s = 61.0}, cost, ENOUGH).ok());
}

TEST(FrameChunks, GrowWhereTheClusterTakesFewJobs) {
    const auto chunks = shareOut(frames(1000), {}, {.frame_s = 100.0}, 7);
    ASSERT_TRUE(chunks.ok());
    EXPECT_THAT(chunks.value(), SizeIs(7));
}

TEST(FrameChunks, AreRefusedWhereAPersonChoseMoreThanTheClusterTakes) {
    const auto refused = shareOut(frames(1000), {.tasks = 8}, {}, 7);
    ASSERT_FALSE(refused.ok());
    EXPECT_THAT(refused.message(), HasSubstr("takes 7 more jobs"));
}

TEST(WarningBeforeTheEnd, IsOneFramesTimeButNoMoment) {
    EXPECT_EQ(warningSeconds({.frame_s = 12.3}), 13);
    EXPECT_EQ(warningSeconds({.frame_s = 0.2}), 5);
    EXPECT_EQ(warningSeconds({}), 60);
    EXPECT_EQ(warningSeconds({.frame_s = 1e6}), 65535);
}

TEST(FrameRangesText, IsReadBackAsTheSameFrames) {
    for (const std::vector<int>& some :
         {std::vector<int>{0}, {0, 1, 2}, {5, 7, 9}, {1, 2, 4, 5, 100}})
        EXPECT_EQ(framesOf(rangesText(some)), some) << rangesText(some);
    for (const char* const wrong : {"7", "a-b", "3-1", "-", "1-2,x"})
        EXPECT_TRUE(framesOf(wrong).empty()) << wrong;
}

} // namespace
} // namespace quarn::program
