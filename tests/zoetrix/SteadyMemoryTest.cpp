#include "tests/zoetrix/AllocationCount.h"
#include "tests/zoetrix/RecordingFixture.h"

#include <cmath>

namespace {

/// A bumpy ground of 2 * 60 * 60 triangles with a name.
std::string groundObj() {
    std::string text;
    for (int y = 0; y <= 60; ++y)
        for (int x = 0; x <= 60; ++x)
            text += "v " + std::to_string(x - 30) + " " + std::to_string(y) + " " +
                    std::to_string(0.5 * std::sin(0.7 * x) * std::cos(0.5 * y)) + "\n";
    text += "o ground\n";
    for (int y = 0; y < 60; ++y)
        for (int x = 1; x <= 60; ++x) {
            const int a = 61 * y + x;
            text += "f " + std::to_string(a) + " " + std::to_string(a + 1) + " " +
                    std::to_string(a + 62) + " " + std::to_string(a + 61) + "\n";
        }
    return text;
}

/// What recordings ask for, with a view of 320 by 200 pixels.
class SteadyMemory : public RecordingFixture, public testing::WithParamInterface<const wchar_t*> {
protected:
    void SetUp() override {
        RecordingFixture::SetUp();
        importObj(groundObj());
        ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 320 200"));
    }

    AllocationCount askedForBy(int frame_count) {
        setUpCameraFrames(frame_count);
        record().SetFolderName(wide(frames));
        record().SetDisplayMode(CQuarnDisplayAttrsMgr::RenderedModeId());
        record().SetFileExtension(GetParam());
        const AllocationCount before = AllocationCount::now();
        EXPECT_EQ(CQuarnCommand::success, run(L"RecordAnimation _Enter"));
        const AllocationCount after = AllocationCount::now();
        EXPECT_EQ(record().Images().Count(), frame_count);
        return {after.small - before.small, after.large - before.large};
    }
};

} // namespace

TEST_P(SteadyMemory, TwentyMoreFramesAskForNoBufferAndForFewStrings) {
    askedForBy(20);
    const AllocationCount twenty = askedForBy(20);
    const AllocationCount forty = askedForBy(40);
    // A buffer that is made for each frame would come twenty times; the page's text, which grows
    // with the frames, doubles its storage now and then.
    EXPECT_LE(forty.large, twenty.large + 2);
    constexpr std::size_t most_small_a_frame = 60;
    const std::size_t small_a_frame = (forty.small - twenty.small) / 20;
    EXPECT_LT(small_a_frame, most_small_a_frame);
    RecordProperty("small_a_frame", static_cast<int>(small_a_frame));
}

INSTANTIATE_TEST_SUITE_P(Formats, SteadyMemory, testing::Values(L"jpg", L"png", L"bmp", L"tga"),
                         [](const auto& format) { return KM_wString(format.param).ToUtf8(); });

TEST(AllocationCounter, CountsWhatTheProgramAsksFor) {
    const AllocationCount before = AllocationCount::now();
    const std::string text(10000, 'x');
    const std::vector<int> numbers(10, 7);
    const AllocationCount after = AllocationCount::now();
    EXPECT_EQ(1U, after.large - before.large);
    EXPECT_EQ(1U, after.small - before.small);
    EXPECT_EQ(10007U, text.size() + static_cast<std::size_t>(numbers[3]));
}
