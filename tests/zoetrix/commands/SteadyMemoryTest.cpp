#include "tests/support/HeldMemory.h"
#include "tests/zoetrix/fixtures/RecordingFixture.h"

#include <algorithm>

namespace {

/// What is held is looked at while the host waits, once or more for every frame.
class LongRecording : public RecordingFixture {
protected:
    static constexpr int frame_count = 200;

    /// Records what is set up.
    void expectSteadyMemory(const wchar_t* format) {
        record().SetFileExtension(format);
        std::vector<std::size_t> held;
        held.reserve(2 * frame_count);
        front_end.while_waiting = [&] { held.push_back(quarn::test::heldMemory()); };
        EXPECT_EQ(CQuarnCommand::success, run(L"RecordAnimation _Enter"));
        front_end.while_waiting = nullptr;
        ASSERT_EQ(frame_count + 3U,
                  files().size()); // with the page, the list and what tells of it all
        ASSERT_GE(held.size(), std::size_t{frame_count});
        const auto quarter = static_cast<std::ptrdiff_t>(held.size() / 4);
        const std::size_t at_first = *std::max_element(held.begin(), held.begin() + quarter);
        const std::size_t at_last = *std::max_element(held.end() - quarter, held.end());
        constexpr std::size_t bytes_a_frame =
            600; // its name for the page, and its line of the list
        EXPECT_LE(at_last, at_first + frame_count * bytes_a_frame + 65536);
    }
};

} // namespace

TEST_F(LongRecording, HoldsNoMoreMemoryInItsLastQuarterThanInItsFirst) {
    setUpCameraFrames(frame_count);
    expectSteadyMemory(L"jpg");
}

TEST_F(LongRecording, OfASunStudyHoldsNoMoreMemoryInItsLastQuarterThanInItsFirst) {
    setUpSunFrames(frame_count);
    expectSteadyMemory(L"png");
}
