#include "tests/quarn/Models.h"
#include "tests/quarn/ProgramRun.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::AllOf;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::MatchesRegex;

class ViewerPageRun : public testing::Test {
protected:
    ViewerPageRun() { writeHouse(m_folder / "house.obj"); }

    Ended record(std::vector<std::string> more) {
        std::vector<std::string> words = {"turntable", "house.obj", "--frames", "3",
                                          "--out",     "out",       "--size",   "64x48"};
        words.insert(words.end(), more.begin(), more.end());
        return inFolder(words);
    }
    Ended inFolder(const std::vector<std::string>& words) {
        Start start;
        start.folder = m_folder.path();
        start.arguments = words;
        return run(start);
    }

    TempFolder m_folder;
};

TEST_F(ViewerPageRun, RecordingWritesThePageWhereItIsAskedFor) {
    const Ended ended = record({"--viewer"});
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.err, IsEmpty());
    EXPECT_THAT(linesOf(ended.out).back(),
                MatchesRegex("out/house-viewer.html: 3 pictures, [0-9]+ kB."));
    EXPECT_THAT(readFile(m_folder / "out/house-viewer.html"), HasSubstr("\"kind\":\"turntable\""));
}

TEST_F(ViewerPageRun, RecordingLeavesPageAndFramesAsTheyAreWithout) {
    ASSERT_EQ(record({}).exit_code, 0);
    const std::string page = readFile(m_folder / "out/house.html");
    EXPECT_FALSE(std::filesystem::exists(m_folder / "out/house-viewer.html"));
    ASSERT_EQ(record({"--one-file"}).exit_code, 0);
    EXPECT_EQ(readFile(m_folder / "out/house.html"), page);
    EXPECT_THAT(readFile(m_folder / "out/house-viewer.html"), HasSubstr("id=\"frame-2\""));
}

TEST_F(ViewerPageRun, PageOfARecordingIsWrittenLater) {
    ASSERT_EQ(record({}).exit_code, 0);
    const Ended ended = inFolder({"page", "out", "--one-file", "--title", "My <house>"});
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(readFile(m_folder / "out/house-viewer.html"),
                AllOf(HasSubstr("<title>My &lt;house&gt;</title>"), HasSubstr("id=\"frame-2\"")));
}

TEST_F(ViewerPageRun, ShowsItsScripts) {
    EXPECT_THAT(record({"--one-file", "--show-script"}).out,
                HasSubstr("\n_-RecordAnimation _TargetFolder \"out\" _Enter\n"
                          "_-ViewerPage \"out/house.frames.json\" _OneFile=Yes _Enter"));
    EXPECT_EQ(linesOf(inFolder({"page", "out", "--title", "A house", "--show-script"}).out)[0],
              "_-ViewerPage \"out\" _Title \"A house\" _Enter");
}

TEST_F(ViewerPageRun, RefusesWhatNoScriptCanHoldAndFoldersWithoutFrames) {
    EXPECT_EQ(inFolder({"page", "out", "--title", "A \"house\""}).exit_code, 2);
    const Ended ended = inFolder({"page", "."});
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("holds no recorded frames"));
}

TEST_F(ViewerPageRun, ThatFailsBehindARecordingTellsBoth) {
    std::filesystem::create_directories(m_folder / "out");
    writeFile(m_folder / "out/house-viewer.html", "mine");
    const Ended ended = record({"--viewer"});
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err,
                AllOf(HasSubstr("3 frames and out/house.html"), HasSubstr("left alone")));
}

} // namespace
} // namespace quarn::test
