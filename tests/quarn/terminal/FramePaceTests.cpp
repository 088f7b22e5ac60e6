#include "quarn/terminal/FramePace.h"

#include <gtest/gtest.h>

namespace quarn::program {
namespace {

using std::chrono::milliseconds;

const FramePace::Clock::time_point START{};

TEST(FramePace, TellsNoPaceAfterTheFirstFrame) {
    FramePace pace;
    pace.noteFrame(1, 120, START);
    EXPECT_EQ(pace.text(), "frame 1 of 120");
}

TEST(FramePace, TellsFramesASecondAndTheTimeThatIsLeft) {
    FramePace pace;
    pace.noteFrame(1, 120, START);
    pace.noteFrame(21, 120, START + milliseconds(1000));
    // 20 frames in a second; 99 are left, which is 4.95 s.
    EXPECT_EQ(pace.text(), "frame 21 of 120, 20 frames/s, 5 s left");
}

TEST(FramePace, RoundsFramesASecondToTenths) {
    FramePace pace;
    pace.noteFrame(1, 0, START);
    pace.noteFrame(4, 0, START + milliseconds(900));
    EXPECT_EQ(pace.text(), "frame 4, 3.3 frames/s");
}

TEST(FramePace, NothingIsLeftAtTheEnd) {
    FramePace pace;
    pace.noteFrame(1, 2, START);
    pace.noteFrame(2, 2, START + milliseconds(500));
    EXPECT_EQ(pace.text(), "frame 2 of 2, 2 frames/s, 0 s left");
}

TEST(FramePace, BeginsAnewWithANewRecording) {
    FramePace pace;
    pace.noteFrame(1, 10, START);
    pace.noteFrame(10, 10, START + milliseconds(100));
    pace.noteFrame(1, 10, START + milliseconds(9000));
    EXPECT_EQ(pace.text(), "frame 1 of 10");
    pace.noteFrame(2, 10, START + milliseconds(9500));
    EXPECT_EQ(pace.text(), "frame 2 of 10, 2 frames/s, 4 s left");
}

TEST(TimeText, GrowsFromSecondsToHours) {
    EXPECT_EQ(timeText(0.042), "0.04 s");
    EXPECT_EQ(timeText(4.14), "4.1 s");
    EXPECT_EQ(timeText(59.94), "59.9 s");
    EXPECT_EQ(timeText(59.96), "1 min 0 s");
    EXPECT_EQ(timeText(200.0), "3 min 20 s");
    EXPECT_EQ(timeText(7500.0), "2 h 5 min");
}

TEST(TimeText, RoughTimesAreRoundedUpToSeconds) {
    EXPECT_EQ(roughTimeText(0.0), "0 s");
    EXPECT_EQ(roughTimeText(0.1), "1 s");
    EXPECT_EQ(roughTimeText(59.1), "1 min 0 s");
}

} // namespace
} // namespace quarn::program
