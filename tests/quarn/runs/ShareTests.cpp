#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

class Share : public testing::Test {
protected:
    Ended share(std::vector<std::string> more) const {
        Start start;
        start.folder = studio.path();
        start.arguments = {"share", "house.obj", "--frames", "3", "--size", "64x48"};
        start.arguments.insert(start.arguments.end(), more.begin(), more.end());
        return run(start);
    }

    const Studio studio;
};

TEST_F(Share, MakesAPageThatCanBeSentAloneAndAFilmBesideTheModel) {
    const Ended ended = share({});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(linesOf(ended.out),
                ElementsAre(StartsWith("3 frames and house/house.html in "),
                            StartsWith("house/house.mp4: 3 frames of 64 x 48 pixels"),
                            StartsWith("house/house-viewer.html: 3 pictures, ")));
    EXPECT_THAT(readFile(studio / "house/house-viewer.html"), HasSubstr(";base64,"));
    EXPECT_THAT(readFile(studio / "house/house.mp4").substr(0, 16), HasSubstr("ftyp"));
}

TEST_F(Share, MakesTheFilmThatIsAskedForWhereItIsAskedFor) {
    ASSERT_EQ(share({"--video", "small.gif", "--name", "Town", "--out", "out"}).exit_code, 0);
    EXPECT_THAT(readFile(studio / "small.gif"), StartsWith("GIF89a"));
    EXPECT_THAT(filesIn(studio / "out"), Contains("Town-viewer.html"));
    EXPECT_THAT(filesIn(studio / "out"), Not(Contains("Town.mp4")));
}

TEST_F(Share, NamesWhatIsInTheWayBeforeAnythingIsDrawn) {
    writeFile(studio / "mine.mp4", "mine");
    const Ended ended = share({"--video", "mine.mp4"});
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("mine.mp4"));
    EXPECT_THAT(ended.err, HasSubstr("--overwrite"));
    EXPECT_EQ(readFile(studio / "mine.mp4"), "mine");
    EXPECT_FALSE(std::filesystem::exists(studio / "house"));
}

TEST_F(Share, ShowsTheScriptThatItRuns) {
    const Ended ended = share({"--show-script"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const auto lines = linesOf(ended.out);
    ASSERT_GE(lines.size(), 4U);
    EXPECT_THAT(lines[lines.size() - 4], HasSubstr("_NextRecording \"house/house.mp4\""));
    EXPECT_THAT(lines.back(), HasSubstr("_OneFile=Yes"));
}

} // namespace
} // namespace quarn::test
