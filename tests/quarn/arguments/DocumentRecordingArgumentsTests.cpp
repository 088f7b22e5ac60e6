#include "tests/quarn/ProgramRun.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;

using Words = std::vector<std::string>;

Ended record(const Words& options) {
    Words arguments = {"record", "site.quarn", "--out", "out"};
    arguments.insert(arguments.end(), options.begin(), options.end());
    return run(arguments);
}

Words scriptOf(Words options) {
    options.push_back("--show-script");
    const Ended ended = record(options);
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    return linesOf(ended.out);
}

/// The program refused its arguments with one line, before it looked for the document.
void expectMisuse(const Ended& ended, const std::string& words) {
    EXPECT_EQ(ended.exit_code, 2);
    EXPECT_THAT(ended.out, IsEmpty());
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, StartsWith("quarn: "));
    EXPECT_THAT(ended.err, HasSubstr(words));
}

TEST(RecordArguments, RangesThatAreNoneAreRefusedByName) {
    expectMisuse(record({"--frames", "12"}), "--frames takes ranges such as 0-9,20-30:2; one frame "
                                             "is 12-12.");
    expectMisuse(record({"--frames", "9-3"}), "--frames 9-3: 9 is behind 3");
    expectMisuse(record({"--frames", "0-9:0"}), "a step is at least 1");
    expectMisuse(record({"--frames", "all"}), "not \"all\"");
    expectMisuse(record({"--frames", "0-99999999999"}), "too large");
    expectMisuse(record({"--frames", "0-10000000"}), "--frames: \"0-10000000\" is no range");
}

TEST(RecordArguments, FolderAndDocumentMustBeNamed) {
    expectMisuse(run({"record", "site.quarn"}), "--out is required");
    expectMisuse(run({"record", "--out", "out"}), "DOC is required");
    expectMisuse(run({"record", "site.obj", "--out", "out"}), "site.obj is no document");
    expectMisuse(run({"finish"}), "DIR is required");
    expectMisuse(run({"finish", "out", "--document", "site.obj"}), "site.obj is no document");
}

TEST(RecordArguments, WhatIsMadeOfAllFramesIsNotMadeOfSome) {
    for (const char* option : {"--viewer", "--one-file"})
        expectMisuse(record({"--frames", "0-9", option}),
                     std::string(option) +
                         " is made of all frames, not of those of --frames: once "
                         "they are there, quarn finish out " +
                         option + " makes it.");
    expectMisuse(record({"--frames", "0-9", "--video", "a.mp4"}), "--video is made of all frames");
    expectMisuse(record({"--fps", "12"}), "--fps is for a film");
    expectMisuse(run({"finish", "out", "--caption"}), "--caption is for a film");
}

TEST(RecordArguments, FolderOfAnAdviceIsAWordForTheShell) {
    expectMisuse(
        run({"record", "site.quarn", "--out", "it's $(mine)", "--frames", "0-9", "--viewer"}),
        "quarn finish 'it'\\''s $(mine)' --viewer makes it.");
}

TEST(RecordArguments, NumbersAreLookedAt) {
    expectMisuse(record({"--jobs", "0"}), "--jobs must be a whole number from 1 to 1024");
    expectMisuse(record({"--quality", "101"}), "--quality must be");
    expectMisuse(run({"finish", "out", "--retries", "-1"}), "--retries must be");
}

TEST(RecordArguments, WhatRecordersAreToldIsNoOptionForPersons) {
    EXPECT_THAT(run({"record", "--help"}).out, Not(HasSubstr("--recorder")));
    for (const char* word : {"--frames", "--jobs", "--resume", "--overwrite", "0-9,20-30:2"})
        EXPECT_THAT(run({"record", "--help"}).out, HasSubstr(word));
}

// ---- Scripts

TEST(RecordScript, GoesOnWithTheWholeRecording) {
    EXPECT_THAT(scriptOf({}), ElementsAre("_-Open \"site.quarn\"",
                                          "# The folder must be there before the recording starts.",
                                          "_-NextRecording _Resume _Enter",
                                          "_-RecordAnimation _TargetFolder \"out\" _Enter"));
    EXPECT_EQ(scriptOf({"--resume"}), scriptOf({}));
}

TEST(RecordScript, HasTheFramesThatAreWanted) {
    EXPECT_THAT(scriptOf({"--frames", "0-9,20-30:2", "--quality", "75"}),
                ElementsAre("_-Open \"site.quarn\"", "_-JpegQuality 75",
                            "# The folder must be there before the recording starts.",
                            "_-NextRecording _Resume 0-9,20-30:2 _Enter",
                            "_-RecordAnimation _TargetFolder \"out\" _Enter"));
}

TEST(RecordScript, BeginsAnewWhereThatIsAskedFor) {
    EXPECT_EQ(scriptOf({"--overwrite"})[2], "_-NextRecording _Anew _Enter");
    expectMisuse(record({"--overwrite", "--resume"}), "give one of them");
    const Ended finished =
        run({"finish", "out", "--document", "site.quarn", "--overwrite", "--show-script"});
    EXPECT_THAT(finished.out, HasSubstr("_-NextRecording _IfSame _Enter"));
}

TEST(RecordScript, MakesFilmAndPageOfTheFolderOnceAllFramesAreThere) {
    const Words lines = scriptOf({"--video", "a.mp4", "--fps", "12", "--one-file"});
    ASSERT_THAT(lines, SizeIs(6));
    EXPECT_EQ(lines[4], "_-Film _FrameRate 12 \"out\" \"a.mp4\"");
    EXPECT_EQ(lines[5], "_-ViewerPage \"out\" _OneFile=Yes _Enter");
}

TEST(FinishScript, NeedsNoFolderWhereTheDocumentIsNamed) {
    const Ended ended = run({"finish", "out", "--document", "site.quarn", "--video", "a.gif",
                             "--viewer", "--show-script"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(linesOf(ended.out),
                ElementsAre("_-Open \"site.quarn\"",
                            "# The folder must be there before the recording starts.",
                            "_-NextRecording _Resume _Enter",
                            "_-RecordAnimation _TargetFolder \"out\" _Enter",
                            "_-Film \"out\" \"a.gif\"", "_-ViewerPage \"out\" _Enter"));
}

} // namespace
} // namespace quarn::test
