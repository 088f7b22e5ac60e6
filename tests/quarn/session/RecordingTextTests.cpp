#include "quarn/session/RecordingText.h"

#include "tests/host/front_end/RecordingReports.h"

#include <gtest/gtest.h>

namespace quarn::program {
namespace {

using quarn::test::reportOf;

TEST(RecordingText, TellsWhatAWholeRecordingWrote) {
    EXPECT_EQ(endText({reportOf(3, 3, 3), ""}),
              "3 frames were written to out; out/house.html plays them.");
    EXPECT_EQ(endText({reportOf(1, 1, 1), ""}),
              "1 frame was written to out; out/house.html plays it.");
}

TEST(RecordingText, TellsWhyAndHowManyPicturesAreMissing) {
    EXPECT_EQ(incompleteText({reportOf(8, 5, 5), "Cannot write 'x': the disk is full."}),
              "only 5 of 8 frames were written to out: Cannot write 'x': the disk is full.");
    EXPECT_EQ(incompleteText({reportOf(8, 0, 0), ""}),
              "only 0 of 8 frames were written to out. Is there space left? out/house.html shows "
              "nothing.");
}

TEST(RecordingText, TellsBothCountsWherePicturesAreGone) {
    EXPECT_EQ(incompleteText({reportOf(150, 150, 109), ""}),
              "150 frames were written to out, but only 109 are there: the others were removed "
              "while it was recorded. out/house.html lists pictures that are not there.");
    EXPECT_EQ(incompleteText({reportOf(150, 120, 109), "the disk is full"}),
              "only 120 of 150 frames were written to out, and 109 of these are there: the disk is "
              "full. out/house.html lists pictures that are not there.");
}

TEST(RecordingText, TellsWhatEarlierRecordingsLeft) {
    RecordingReport report = reportOf(3, 3, 3);
    EXPECT_EQ(leftOverText(report), "");
    report.left_over = 2;
    report.first_left_over = L"house003.jpg";
    EXPECT_EQ(leftOverText(report),
              "out still holds 2 pictures of an earlier recording: house003.jpg, ...");
}

TEST(RecordingText, TellsWhatAStoppedRecordingPlays) {
    EXPECT_EQ(interruptedText(reportOf(100, 7, 7)),
              "Stopped after 7 of 100 frames; out/house.html plays what is there.");
    RecordingReport without_page = reportOf(100, 7, 7);
    without_page.has_page = false;
    EXPECT_EQ(interruptedText(without_page),
              "Stopped after 7 of 100 frames; the page out/house.html could not be written.");
}

} // namespace
} // namespace quarn::program
