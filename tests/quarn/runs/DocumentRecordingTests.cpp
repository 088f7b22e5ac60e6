// quarn record and quarn finish: parts of a recording, and what makes them one.
#include "tests/quarn/runs/RecordedDocument.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;

class DocumentRecording : public testing::Test {
protected:
    /// Records into a folder what must succeed.
    std::string recordInto(const std::string& out, const std::vector<std::string>& options = {}) {
        const Ended ended = run(house.record(out, options));
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_THAT(ended.err, IsEmpty());
        return ended.out;
    }
    std::string finish(std::vector<std::string> arguments) {
        arguments.insert(arguments.begin(), "finish");
        const Ended ended = house.run(arguments);
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        return ended.out;
    }
    void expectFailure(const Ended& ended, const std::string& words) {
        EXPECT_EQ(ended.exit_code, 1);
        EXPECT_THAT(ended.out, IsEmpty());
        EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
        EXPECT_THAT(ended.err, HasSubstr(words));
    }

    const RecordedDocument house;
};

// ---- Parts

TEST_F(DocumentRecording, OfSomeFramesHasTheSameBytesAsTheWholeAndNoPage) {
    EXPECT_THAT(recordInto("whole"), StartsWith("12 frames and whole/house.html in "));
    EXPECT_THAT(recordInto("part", {"--frames", "3-5,8-11:2"}),
                MatchesRegex("5 frames of house in part in [0-9.]+ s; quarn finish part makes the "
                             "page once all are there\n"));
    for (const char* name :
         {"house003.jpg", "house004.jpg", "house005.jpg", "house008.jpg", "house010.jpg"})
        EXPECT_EQ(readFile(house / "part" / name), readFile(house / "whole" / name)) << name;
    EXPECT_EQ(house.picturesIn("part"), 5);
    EXPECT_FALSE(std::filesystem::exists(house / "part/house.html"));
    EXPECT_FALSE(std::filesystem::exists(house / "part/house.frames.json"));
}

TEST_F(DocumentRecording, InTwoPartsIsTheSameAsInOneOnceItIsFinished) {
    recordInto("whole");
    recordInto("parts", {"--frames", "6-11"});
    recordInto("parts", {"--frames", "0-5"});
    EXPECT_THAT(finish({"parts"}),
                MatchesRegex("12 frames and parts/house.html in [0-9.]+ s \\(all "
                             "of them were there already\\)\n"));
    EXPECT_THAT(house.recorded("parts"), SizeIs(14));
    EXPECT_EQ(house.recorded("parts"), house.recorded("whole"));
}

TEST_F(DocumentRecording, GoesOnWithThePartsThatAreThere) {
    recordInto("out", {"--frames", "0-3,10-10"});
    const auto before = house.markOf("out/house010.jpg");
    EXPECT_THAT(recordInto("out", {"--frames", "2-5"}),
                HasSubstr("s (2 of them were there already); quarn finish out makes"));
    EXPECT_THAT(recordInto("out"), HasSubstr("12 frames and out/house.html"));
    EXPECT_EQ(house.markOf("out/house010.jpg"), before);
    recordInto("whole");
    EXPECT_EQ(house.recorded("out"), house.recorded("whole"));
    EXPECT_THAT(recordInto("out"), HasSubstr("(all of them were there already)"));
    EXPECT_EQ(house.markOf("out/house010.jpg"), before);
}

TEST_F(DocumentRecording, OfFramesBeyondTheEndIsRefused) {
    expectFailure(run(house.record("out", {"--frames", "8-12"})),
                  "quarn: There is no frame 12: the animation house has the frames 0 to 11.");
    EXPECT_EQ(house.picturesIn("out"), 0);
}

/// The camera of one frame stands straight above its target: what is up there it takes over from
/// the frame before.
TEST_F(DocumentRecording, OfACameraThatPassesAboveItsTargetHasTheSameBytesInParts) {
    writeFile(house / "over.txt", "-6 0 9\n6 0 9\n");
    const Ended made = house.run({"path", "house.obj", "--camera-curve", "over.txt",
                                  "--target-point", "0,0,1", "--frames", "9", "--size", "64x48",
                                  "--out", "made", "--name", "house", "--save", "house.quarn"});
    ASSERT_EQ(made.exit_code, 0) << made.err;
    recordInto("part", {"--frames", "4-6"});
    for (const char* name : {"house004.jpg", "house005.jpg", "house006.jpg"})
        EXPECT_EQ(readFile(house / "part" / name), readFile(house / "made" / name)) << name;
    (void)house.run({"frame", "house.quarn", "--number", "4", "--out", "alone.jpg"});
    EXPECT_NE(readFile(house / "alone.jpg"), readFile(house / "part/house004.jpg"))
        << "frame 4 takes nothing over";
}

// ---- Frames that are not whole

TEST_F(DocumentRecording, MakesFramesAgainThatWereCutEmptiedAlteredOrRemoved) {
    recordInto("whole");
    recordInto("out");
    const auto untouched = house.markOf("out/house000.jpg");
    const std::string bytes = readFile(house / "out/house002.jpg");
    std::string altered = bytes;
    altered[altered.size() / 2] ^= 1;
    writeFile(house / "out/house003.jpg", bytes.substr(0, bytes.size() / 2));
    writeFile(house / "out/house004.jpg", "");
    writeFile(house / "out/house002.jpg", altered);
    writeFile(house / "out/house006.jpg", readFile(house / "out/house006.jpg") + "more");
    std::filesystem::remove(house / "out/house011.jpg");
    EXPECT_THAT(finish({"out"}), HasSubstr("(7 of them were there already)"));
    EXPECT_EQ(house.recorded("out"), house.recorded("whole"));
    EXPECT_EQ(house.markOf("out/house000.jpg"), untouched);
}

TEST_F(DocumentRecording, TellsWhichFramesCannotBeMade) {
    recordInto("out", {"--frames", "0-3"});
    std::filesystem::create_directory(house / "out/house007.jpg");
    const Ended ended = house.run({"finish", "out", "--retries", "1"});
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("only 7 of 12 frames are in out"));
    EXPECT_THAT(ended.err, HasSubstr(" Frames 7-11 are missing."));
}

// ---- Another recording

TEST_F(DocumentRecording, OfADocumentThatChangedIsRefusedAndMadeAnewWhereThatIsAskedFor) {
    recordInto("out");
    const auto files = house.recorded("out");
    house.save("house.quarn", 12, "64 48", "_-Hide tower\n");
    for (const std::vector<std::string>& arguments :
         {std::vector<std::string>{"record", "house.quarn", "--out", "out"},
          {"record", "house.quarn", "--out", "out", "--frames", "0-3"},
          {"record", "house.quarn", "--out", "out", "--jobs", "2"},
          {"finish", "out"}}) {
        expectFailure(house.run(arguments), "quarn: house in out was recorded before ");
        EXPECT_EQ(house.recorded("out"), files);
    }
    recordInto("out", {"--overwrite"});
    recordInto("whole");
    EXPECT_EQ(house.recorded("out"), house.recorded("whole"));
    EXPECT_NE(house.recorded("out"), files);
}

TEST_F(DocumentRecording, OfAnotherQualityIsRefused) {
    recordInto("out", {"--frames", "0-3"});
    const auto before = house.markOf("out/house000.jpg");
    expectFailure(run(house.record("out", {"--quality", "40"})),
                  "house in out was recorded before");
    EXPECT_EQ(house.markOf("out/house000.jpg"), before);
    EXPECT_EQ(house.picturesIn("out"), 4);
    recordInto("out", {"--quality", "40", "--overwrite"});
    recordInto("low", {"--quality", "40"});
    EXPECT_EQ(house.recorded("out"), house.recorded("low"));
}

TEST_F(DocumentRecording, LeavesFilesOfOthersAlone) {
    std::filesystem::create_directory(house / "out");
    writeFile(house / "out/house005.jpg", "a texture");
    expectFailure(run(house.record("out")), "out/house005.jpg is not replaced");
    EXPECT_THAT(filesIn(house / "out"), ElementsAre("house005.jpg"));
    recordInto("out", {"--overwrite"});
    EXPECT_TRUE(readPictureHeader(house / "out/house005.jpg"));
}

TEST_F(DocumentRecording, IsDrawnOnWithTheInstructionsThatItWasBegunWith) {
    recordInto("slow", {"--instructions", "sse2"});
    recordInto("out", {"--frames", "0-3", "--instructions", "sse2"});
    recordInto("out");
    EXPECT_EQ(house.recorded("out"), house.recorded("slow"));
}

// ---- Documents

TEST_F(DocumentRecording, NeedsADocumentWithAnAnimation) {
    expectFailure(house.run({"record", "missing.quarn", "--out", "out"}), "missing.quarn");
    writeFile(house / "save.txt", "_-SaveAs still.quarn\n");
    ASSERT_EQ(house.run({"run", "save.txt", "house.obj"}).exit_code, 0);
    expectFailure(house.run({"record", "still.quarn", "--out", "out"}),
                  "still.quarn has no animation that can be recorded");
    EXPECT_FALSE(std::filesystem::exists(house / "out"));
}

TEST_F(DocumentRecording, IsFinishedFromAnotherPlaceOfItsDocument) {
    recordInto("out", {"--frames", "0-3"});
    std::filesystem::rename(house / "house.quarn", house / "moved.quarn");
    expectFailure(house.run({"finish", "out"}), "is not there: say with --document where it is.");
    finish({"out", "--document", "moved.quarn"});
    EXPECT_EQ(house.recorded("out").size(), 14U);
}

TEST_F(DocumentRecording, OfNoSavedDocumentCannotBeFinishedWithoutOne) {
    ASSERT_EQ(
        house.run({"turntable", "house.obj", "--frames", "3", "--size", "64x48", "--out", "out"})
            .exit_code,
        0);
    expectFailure(house.run({"finish", "out"}),
                  "out does not say which saved document it was recorded from");
    expectFailure(house.run({"finish", "."}), "holds no recording");
    expectFailure(house.run({"finish", "nowhere"}), "nowhere holds no recording");
}

TEST_F(DocumentRecording, ThatIsWholeButForItsPageGetsItWithFilmAndViewer) {
    recordInto("out", {"--frames", "0-11"});
    const std::string told = finish({"out", "--video", "house.gif", "--one-file"});
    ASSERT_THAT(linesOf(told), SizeIs(3)) << told;
    EXPECT_THAT(linesOf(told)[0], HasSubstr("(all of them were there already)"));
    EXPECT_THAT(linesOf(told)[1], StartsWith("house.gif: 12 frames of 64 x 48 pixels"));
    EXPECT_THAT(linesOf(told)[2], StartsWith("out/house-viewer.html: 12 pictures, "));
    EXPECT_THAT(readFile(house / "house.gif"), StartsWith("GIF89a"));
    // A film that is there is told before anything is read.
    expectFailure(house.run({"finish", "out", "--video", "house.gif"}), "house.gif");
    finish({"out", "--video", "house.gif", "--overwrite"});
}

TEST_F(DocumentRecording, ThatGoesOnHasKeptFramesInItsFilm) {
    recordInto("whole", {"--video", "whole.gif"});
    recordInto("out", {"--frames", "4-7"});
    recordInto("out", {"--video", "parts.gif"});
    EXPECT_EQ(readFile(house / "parts.gif"), readFile(house / "whole.gif"));
}

} // namespace
} // namespace quarn::test
