#include "host/recording/FrameMemory.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

TEST(MemoryOfFrames, IsToldWithWhatIsFreeWhereItDoesNotFit) {
    constexpr std::uint64_t free_bytes = 3ULL << 30;
    EXPECT_FALSE(framesBeyondMemory(1000, free_bytes));
    const auto why = framesBeyondMemory(100'000'000, free_bytes);
    ASSERT_TRUE(why);
    // 100,000,000 frames of 1,700 bytes.
    EXPECT_THAT(why->ToUtf8(), HasSubstr("100000000 frames would take about 158.3 GB of memory"));
    EXPECT_THAT(why->ToUtf8(), HasSubstr("3.0 GB are free"));
}

TEST(MemoryOfFrames, CountsBeyondAnyMachineAreTold) {
    EXPECT_TRUE(framesBeyondMemory(2147483647));
    EXPECT_EQ(memoryOfFrames(-5), 0U);
}

} // namespace
} // namespace quarn::test
