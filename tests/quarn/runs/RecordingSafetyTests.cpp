// What a recording leaves alone, and what it says where it is not what it should be.
#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <csignal>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::Not;
using testing::SizeIs;

class RecordingSafety : public testing::Test {
protected:
    bool exists(const std::string& name) const { return std::filesystem::exists(studio / name); }

    /// A turntable by a script, into the folder "out".
    Start script(int frames, const std::string& extension, const std::string& before = "") const {
        std::filesystem::create_directories(studio / "out");
        writeFile(studio / "steps.txt",
                  "_-ViewportSize 160 120\n_-FitView _Turn=Yes _Enter\n" + before +
                      "_-SetTurntableAnimation " + std::to_string(frames) + " _Clockwise _" +
                      extension + " _Shaded _Enter _Enter\n_-RecordAnimation out _Enter\n");
        Start start;
        start.folder = studio.path();
        start.arguments = {"run", "steps.txt", "house.obj", "--language", "en"};
        return start;
    }

    const Studio studio;
};

// ---- Success that is none

TEST_F(RecordingSafety, ScriptWhosePicturesDoNotFitFailsAndTellsThatThePageShowsNothing) {
    Start start = script(4, "bmp");
    start.largest_file = 50000; // less than one picture
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
    EXPECT_THAT(ended.err, HasSubstr("quarn: only 0 of 4 frames were written to out: "));
    EXPECT_THAT(ended.err, HasSubstr("out/Animation.html shows nothing."));
    EXPECT_THAT(readFile(studio / "out/Animation.html"), HasSubstr("ImageCount = 0;"));
}

TEST_F(RecordingSafety, ScriptWhoseRenderedPicturesDoNotFitFails) {
    std::filesystem::create_directories(studio / "out");
    writeFile(studio / "steps.txt",
              "_-RenderSettings _Size 160 120 _PreviewSamples 1 _Enter\n"
              "_-SetTurntableAnimation 4 _Clockwise _bmp _RenderPreview _Enter _Enter\n"
              "_-RecordAnimation out _Enter\n");
    Start start;
    start.folder = studio.path();
    start.arguments = {"run", "steps.txt", "house.obj", "--language", "en"};
    start.largest_file = 50000;
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("quarn: only 0 of 4 frames were written to out: "));
}

TEST_F(RecordingSafety, ScriptWhosePicturesHaveTooLongANameFails) {
    // The page's name has 255 letters, which is the most there can be.
    const std::string name(250, 'a');
    const Start start = script(2, "png", "_-AnimationName " + name + "\n");
    for (int time = 0; time < 2; ++time) {
        const Ended ended = run(start);
        EXPECT_EQ(ended.exit_code, 1);
        EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
        EXPECT_THAT(ended.err, HasSubstr("quarn: only 0 of 2 frames were written to out: "));
        EXPECT_THAT(ended.err, HasSubstr("the name is too long"));
        EXPECT_THAT(ended.err, HasSubstr(".html shows nothing."));
        EXPECT_THAT(filesIn(studio / "out"), ElementsAre(name + ".html"));
    }
}

TEST_F(RecordingSafety, ScriptThatEndsAtARecordingTellsWhatThatLacks) {
    const Ended ended = run(script(2, "png", "_-AnimationName " + std::string(255, 'a') + "\n"));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err),
                ElementsAre("quarn: steps.txt, line 5: _-RecordAnimation out _Enter: failed.",
                            HasSubstr("quarn: only 0 of 2 frames were written to out: ")));
    EXPECT_THAT(filesIn(studio / "out"), IsEmpty());
}

TEST_F(RecordingSafety, ScriptTellsWhatEachOfItsRecordingsWrote) {
    const Ended ended = run(script(2, "png"));
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out,
                HasSubstr("2 frames were written to out; out/Animation.html plays them.\n"));
}

TEST_F(RecordingSafety, FolderThatIsRemovedMeanwhileIsToldWithBothCounts) {
    for (const Start& start : {studio.turntable(60, {"--name", "Animation"}), script(60, "jpg")}) {
        std::filesystem::create_directories(studio / "out");
        RunningProgram program(start);
        ASSERT_TRUE(program.waitUntil([&] { return exists("out/Animation009.jpg"); }));
        std::filesystem::rename(studio / "out", studio / "away");
        const Ended ended = program.wait();
        EXPECT_EQ(ended.exit_code, 1) << ended.out;
        const std::size_t pictures =
            filesIn(studio / "out").size() - 3; // page, list, recording file
        EXPECT_LT(pictures, 51U);
        EXPECT_THAT(ended.err, MatchesRegex("quarn: 60 frames were written to out, but only " +
                                            std::to_string(pictures) +
                                            " are there: [a-z ]+\\. out/Animation\\.html lists "
                                            "pictures that are not there\\.\n"));
        std::filesystem::remove_all(studio / "away");
        std::filesystem::remove_all(studio / "out");
    }
}

TEST_F(RecordingSafety, ConsoleTellsWhatIsMissing) {
    std::filesystem::create_directories(studio / "out");
    Start start;
    start.folder = studio.path();
    start.arguments = {"console", "house.obj", "--language", "en"};
    start.input = "ViewportSize 160 120\nSetTurntableAnimation 2 Clockwise bmp Shaded _Enter "
                  "_Enter\nRecordAnimation out _Enter\n";
    start.largest_file = 50000;
    EXPECT_THAT(run(start).out, HasSubstr("only 0 of 2 frames were written to out: "));
}

// ---- Files of others

TEST_F(RecordingSafety, TextureThatIsCalledLikeAFrameIsNotReplaced) {
    std::filesystem::create_directory(studio / "out");
    writeFile(studio / "out/house001.png", "a texture");
    // Seen before the model, which cannot be read, is looked at.
    writeFile(studio / "house.obj", "no model");
    const Ended ended = run(studio.turntable(3, {"--format", "png"}));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_EQ(ended.err, "quarn: out/house001.png is not replaced: no recording named house wrote "
                         "it. Record into another folder or under another name, or start the "
                         "program with --overwrite.\n");
    EXPECT_EQ(readFile(studio / "out/house001.png"), "a texture");
    EXPECT_THAT(filesIn(studio / "out"), ElementsAre("house001.png"));
}

TEST_F(RecordingSafety, ScriptDoesNotReplaceThePageOfAPerson) {
    const Start start = script(2, "png");
    writeFile(studio / "out/Animation.html", "<p>mine");
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.out, HasSubstr("out/Animation.html is not replaced"));
    EXPECT_EQ(readFile(studio / "out/Animation.html"), "<p>mine");
    EXPECT_THAT(filesIn(studio / "out"), ElementsAre("Animation.html"));
}

TEST_F(RecordingSafety, OverwriteReplacesWhatIsInTheWay) {
    Start start = script(2, "png");
    writeFile(studio / "out/Animation.html", "<p>mine");
    writeFile(studio / "out/Animation001.png", "a texture");
    start.arguments.push_back("--overwrite");
    EXPECT_EQ(run(start).exit_code, 0);
    EXPECT_TRUE(readPictureHeader(studio / "out/Animation001.png"));
    std::filesystem::create_directory(studio / "one");
    writeFile(studio / "one/house000.jpg", "mine");
    EXPECT_EQ(run(studio.turntable(1, {"--out", "one", "--overwrite"})).exit_code, 0);
    EXPECT_TRUE(readPictureHeader(studio / "one/house000.jpg"));
}

TEST_F(RecordingSafety, WriteProtectedPicturePageAndDocumentAreReplacedOnlyWhereThatIsAskedFor) {
    const std::vector<std::string> saving = {"--save", "house.quarn"};
    ASSERT_EQ(run(studio.turntable(2, saving)).exit_code, 0);
    for (const char* name : {"out/house001.jpg", "out/house.html", "house.quarn"}) {
        std::filesystem::permissions(studio / name, std::filesystem::perms(0444));
        const std::string before = readFile(studio / name);
        const Ended ended = run(
            studio.turntable(2, {"--elevation", "50", "--mode", "Clay", "--save", "house.quarn"}));
        EXPECT_EQ(ended.exit_code, 1) << name;
        EXPECT_THAT(ended.err, HasSubstr("protected"));
        EXPECT_EQ(readFile(studio / name), before);
        EXPECT_EQ(run(studio.turntable(2, {"--save", "house.quarn", "--overwrite"})).exit_code, 0);
        std::filesystem::permissions(studio / name, std::filesystem::perms(0644));
    }
}

TEST_F(RecordingSafety, FolderOfAProgramWithoutRecordingFilesIsRecordedIntoAgain) {
    ASSERT_EQ(run(studio.turntable(3)).exit_code, 0);
    std::filesystem::remove(studio / "out/house.recording");
    EXPECT_EQ(run(studio.turntable(3)).exit_code, 0) << "the page lists the frames";
    std::filesystem::remove(studio / "out/house.recording");
    writeFile(studio / "out/house003.jpg", "mine");
    EXPECT_EQ(run(studio.turntable(4)).exit_code, 1);
    EXPECT_EQ(readFile(studio / "out/house003.jpg"), "mine");
}

TEST_F(RecordingSafety, ShorterRecordingTellsWhatTheLongerOneBeforeItLeft) {
    ASSERT_EQ(run(studio.turntable(5)).exit_code, 0);
    const Ended ended = run(studio.turntable(3));
    EXPECT_EQ(ended.exit_code, 0);
    EXPECT_THAT(ended.out, HasSubstr("\nout still holds 2 pictures of an earlier recording: "
                                     "house003.jpg, ...\n"));
    EXPECT_THAT(run(studio.turntable(5)).out, Not(HasSubstr("still holds")));
}

// ---- Two recordings

TEST_F(RecordingSafety, SecondOneOfTheSameNameIsRefusedWhileTheFirstRuns) {
    RunningProgram first(studio.turntable(100000));
    ASSERT_TRUE(first.waitUntil([&] { return exists("out/house002.jpg"); }));
    const Ended second = run(studio.turntable(2, {"--overwrite"}));
    EXPECT_EQ(second.exit_code, 1);
    EXPECT_THAT(second.err, HasSubstr("house is being recorded into out by process "));
    EXPECT_FALSE(exists("out/house.html"));
    EXPECT_EQ(run(studio.turntable(2, {"--name", "other"})).exit_code, 0);
    first.sendSignal(SIGKILL);
    EXPECT_EQ(first.wait().killed_by, SIGKILL);
    const Ended again = run(studio.turntable(2));
    EXPECT_EQ(again.exit_code, 0) << again.err;
    EXPECT_THAT(again.out, HasSubstr("still holds"));
}

// ---- More frames than memory holds

TEST_F(RecordingSafety, FramesBeyondMemoryAreRefusedBeforeTheModelIsRead) {
    writeFile(studio / "house.obj", "no model");
    const Ended ended = run(studio.turntable(2147483647));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("quarn: 2147483647 frames would take about 3400.0 GB of "
                                     "memory, and "));
    EXPECT_FALSE(exists("out"));
}

TEST_F(RecordingSafety, FramesBeyondMemoryAreNoAnswerToAQuestionForThem) {
    const Ended script_end = run(script(2147483647, "png"));
    EXPECT_EQ(script_end.exit_code, 1);
    EXPECT_THAT(script_end.out, HasSubstr("2147483647 frames would take about 3400.0 GB"));
    Start start;
    start.folder = studio.path();
    start.arguments = {"console", "house.obj", "--language", "en"};
    start.input = "SetTurntableAnimation 2147483647\n3\n_Cancel\nList\n";
    const Ended console = run(start);
    EXPECT_EQ(console.exit_code, 0);
    EXPECT_THAT(console.out, HasSubstr("would take about 3400.0 GB"));
    EXPECT_THAT(console.out, HasSubstr("Direction")) << "it is asked again, and answered";
}

} // namespace
} // namespace quarn::test
