#include "desktop/animation/RecordingText.h"

#include "tests/host/front_end/RecordingReports.h"

#include <gtest/gtest.h>

namespace quarn::desktop::test {
namespace {

using quarn::test::reportOf;

TEST(RecordingTextTest, TellsHowManyPicturesThereAre) {
    EXPECT_EQ(recordingText(reportOf(3, 3, 3)), "3 pictures were written to out.");
    EXPECT_EQ(recordingText(reportOf(8, 5, 5)), "Only 5 of 8 pictures were written to out.");
    EXPECT_EQ(recordingText(reportOf(8, 0, 0)),
              "Only 0 of 8 pictures were written to out. The page house.html shows nothing.");
    EXPECT_EQ(recordingText(reportOf(150, 150, 109)),
              "150 pictures were written to out, but only 109 are still there. The page house.html "
              "lists pictures that are not there.");
}

TEST(RecordingTextTest, TellsWhatEarlierRecordingsLeft) {
    RecordingReport report = reportOf(3, 3, 3);
    report.left_over = 2;
    report.first_left_over = L"house003.jpg";
    EXPECT_EQ(recordingText(report),
              "3 pictures were written to out. 2 pictures of an earlier recording are still there, "
              "the first is house003.jpg.");
}

} // namespace
} // namespace quarn::desktop::test
