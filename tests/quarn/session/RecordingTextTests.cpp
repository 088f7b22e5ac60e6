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

RecordingReport keptOf(int expected, int written, int kept) {
    RecordingReport report = reportOf(expected, written, written + kept);
    report.kept = kept;
    return report;
}

TEST(RecordingText, TellsHowManyFramesWereThereAlready) {
    EXPECT_EQ(doneText(keptOf(200, 50, 150), 12.0),
              "200 frames and out/house.html in 12 s (150 of them were there already)");
    EXPECT_EQ(doneText(keptOf(200, 0, 200), 1.25),
              "200 frames and out/house.html in 1.3 s (all of them were there already)");
    EXPECT_EQ(doneText(keptOf(2, 2, 0), 0.5), "2 frames and out/house.html in 0.5 s");
    EXPECT_EQ(endText({keptOf(3, 1, 2), ""}),
              "3 frames are in out (2 of them were there already); out/house.html plays them.");
}

TEST(RecordingText, TellsOfAPartWhatMakesThePage) {
    RecordingReport part = keptOf(50, 50, 0);
    part.is_part = true;
    part.has_page = false;
    EXPECT_EQ(doneText(part, 3.1),
              "50 frames of house in out in 3.1 s; quarn finish out makes the page once all are "
              "there");
    part.folder = "my out";
    part.kept = 20;
    EXPECT_EQ(doneText(part, 3.1),
              "50 frames of house in my out in 3.1 s (20 of them were there already); quarn finish "
              "'my out' makes the page once all are there");
    EXPECT_EQ(endText({part, ""}), "50 frames are in my out (20 of them were there already).");
}

TEST(RecordingText, TellsThatAStoppedRecordingGoesOn) {
    EXPECT_EQ(stoppedText(keptOf(100, 7, 0)),
              "Stopped after 7 of 100 frames; out/house.html plays what is there. The same command "
              "goes on where it stopped.");
    RecordingReport part = keptOf(100, 7, 30);
    part.is_part = true;
    part.has_page = false;
    EXPECT_EQ(stoppedText(part), "Stopped after 37 of 100 frames (30 of them were there already). "
                                 "The same command goes on where it stopped.");
}

TEST(RecordingText, TellsWhyFramesAreMissingBesideThoseThatWereThere) {
    EXPECT_EQ(incompleteText({keptOf(8, 1, 4), "Cannot write 'x': the disk is full."}),
              "only 5 of 8 frames are in out (4 of them were there already): Cannot write 'x': the "
              "disk is full.");
    RecordingReport shared = keptOf(8, 1, 4);
    shared.elsewhere = 3;
    EXPECT_EQ(incompleteText({shared, ""}),
              "5 of 8 frames are in out; other programs are recording 3 of them.");
}

} // namespace
} // namespace quarn::program
