// Recordings for which nobody names a folder or a number of frames.
#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::SizeIs;

Ended turntable(const Studio& studio, std::vector<std::string> options = {}) {
    Start start;
    start.folder = studio.path();
    start.arguments = {"turntable", "house.obj", "--size", "32x24", "--mode", "Wireframe"};
    start.arguments.insert(start.arguments.end(), options.begin(), options.end());
    return run(start);
}

TEST(OwnFolder, TakesAWholeTurnBesideTheModel) {
    const Studio studio;
    const Ended ended = turntable(studio);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("72 frames and house/house.html in "));
    const auto files = filesIn(studio / "house");
    EXPECT_THAT(files, SizeIs(75)) << "with the page and two lists";
    EXPECT_THAT(files, Contains("house071.jpg"));
    EXPECT_THAT(filesIn(studio.path()), ElementsAre("house", "house.obj"));
}

TEST(OwnFolder, IsRecordedIntoAgain) {
    const Studio studio;
    ASSERT_EQ(turntable(studio, {"--frames", "3"}).exit_code, 0);
    writeFile(studio / "house/notes.txt", "mine");
    EXPECT_EQ(turntable(studio, {"--frames", "2", "--name", "Second"}).exit_code, 0);
    EXPECT_EQ(readFile(studio / "house/notes.txt"), "mine");
}

TEST(OwnFolder, MayBeThereAndEmpty) {
    const Studio studio;
    std::filesystem::create_directory(studio / "house");
    EXPECT_EQ(turntable(studio, {"--frames", "1"}).exit_code, 0);
}

TEST(OwnFolder, ThatHoldsFilesOfOthersIsLeftAlone) {
    for (const char* file : {"house/wood.png", "house/fake.recording", "house/sub/a.txt"}) {
        const Studio studio;
        std::filesystem::create_directories((studio / file).parent_path());
        writeFile(studio / file, "mine");
        for (const std::vector<std::string>& options :
             {std::vector<std::string>{"--frames", "1"}, {"--frames", "1", "--overwrite"}}) {
            const Ended ended = turntable(studio, options);
            EXPECT_EQ(ended.exit_code, 1) << file;
            EXPECT_EQ(ended.err, "quarn: house is there already, and nothing was recorded into it; "
                                 "choose the folder for the pictures with --out.\n");
        }
        EXPECT_THAT(filesIn(studio / "house"), SizeIs(1));
        EXPECT_EQ(turntable(studio, {"--frames", "1", "--out", "house"}).exit_code, 0)
            << "who names it, means it";
    }
}

TEST(OwnFolder, OfAModelWithoutExtensionWouldBeTheModel) {
    const Studio studio;
    std::filesystem::rename(studio / "house.obj", studio / "house");
    Start start;
    start.folder = studio.path();
    start.arguments = {"turntable", "house", "--frames", "1"};
    const Ended refused = run(start);
    EXPECT_EQ(refused.exit_code, 1);
    EXPECT_THAT(refused.err, HasSubstr("--out"));
    EXPECT_TRUE(std::filesystem::is_regular_file(studio / "house"));
}

TEST(Quality, MakesSmallerOrFinerJpgs) {
    const Studio studio;
    const auto size = [&](const char* quality) {
        const std::string out = std::string("q") + quality;
        std::vector<std::string> options = {"--frames", "1", "--out", out};
        if (*quality)
            options.insert(options.end(), {"--quality", quality});
        EXPECT_EQ(turntable(studio, options).exit_code, 0);
        return readFile(studio / out / "house000.jpg");
    };
    EXPECT_LT(size("20").size(), size("90").size());
    EXPECT_LT(size("90").size(), size("100").size());
    EXPECT_EQ(size(""), size("90")) << "which is the quality without the option";
}

} // namespace
} // namespace quarn::test
