#include "engine/images/PictureMemory.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn {
namespace {

using ::testing::HasSubstr;

constexpr std::uint64_t gigabyte = 1ULL << 30;

TEST(PictureMemory, PictureThatDoesNotFitIsRefusedWithWhatItNeedsAndWhatIsFree) {
    // 16384 * 16384 * 18 bytes are 4.5 GB.
    const Result<void> checked = checkPictureMemory(16384, 16384, 0, 2 * gigabyte);
    ASSERT_FALSE(checked.ok());
    EXPECT_THAT(checked.message(), HasSubstr("16384 by 16384"));
    EXPECT_THAT(checked.message(), HasSubstr("needs 4.5 GB, and 2.0 GB are free"));
}

TEST(PictureMemory, PictureThatFitsIsDrawn) {
    EXPECT_TRUE(checkPictureMemory(16384, 16384, 0, 5 * gigabyte).ok());
    EXPECT_TRUE(checkPictureMemory(1, 1, 0).ok());
    EXPECT_TRUE(checkPictureMemory(4096, 4096, 0).ok());
}

TEST(PictureMemory, MemoryThatIsHeldAlreadyIsNotAskedForAgain) {
    EXPECT_TRUE(checkPictureMemory(16384, 16384, 16384LL * 16384, 0).ok());
    EXPECT_FALSE(checkPictureMemory(16384, 16384, 16383LL * 16384, 0).ok());
}

} // namespace
} // namespace quarn
