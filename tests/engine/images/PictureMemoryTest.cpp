#include "engine/images/PictureMemory.h"

#include "tests/engine/display/DisplayFixture.h"
#include "tests/support/HeldMemory.h"

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

TEST(PictureMemory, OfALargePictureGoesAfterManySmallOnes) {
    SceneContent content;
    addMesh(content, hillMesh(40), {150, 140, 120, 255});
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    const KM_Viewport camera = perspectiveView({90.0, 0.0, 45.0}, {0.0, 0.0, 2.0});
    DisplayPipeline pipeline;
    const auto heldAfter = [&](int width, int height) {
        Image picture;
        EXPECT_TRUE(
            pipeline.draw(scene, camera, modeNamed(L"X-Ray", 2), width, height, picture).ok());
        picture = Image();
        return test::heldMemory();
    };
    constexpr std::size_t megabyte = 1 << 20;
    const std::size_t small_first = heldAfter(40, 24);
    const std::size_t large = heldAfter(1200, 800);
    EXPECT_GE(large, small_first + 10 * megabyte); // layers alone take 3.8 MB for each kept
    EXPECT_EQ(pipeline.heldPixels(), 1200 * 800);
    EXPECT_GE(heldAfter(40, 24), small_first + 10 * megabyte);
    std::size_t small_last = 0;
    for (int i = 0; i < 130; ++i)
        small_last = heldAfter(40, 24);
    EXPECT_LE(small_last, small_first + 2 * megabyte);
    EXPECT_EQ(pipeline.heldPixels(), 40 * 24);
}

} // namespace
} // namespace quarn
