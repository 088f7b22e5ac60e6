#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <regex>
#include <sys/mount.h>
#include <unistd.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

TEST(OutputFolder, IsMadeWithAllFoldersAboveIt) {
    const Studio studio;
    ASSERT_EQ(run(studio.turntable(1, {"--out", "a/b/c"})).exit_code, 0);
    EXPECT_TRUE(std::filesystem::exists(studio / "a/b/c/house000.jpg"));
}

TEST(OutputFolder, ThatIsAFileIsToldAndTheFileStays) {
    const Studio studio;
    writeFile(studio / "out", "mine");
    const Ended ended = run(studio.turntable(2));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, HasSubstr("output folder out"));
    EXPECT_THAT(ended.err, HasSubstr("--out"));
    EXPECT_EQ(readFile(studio / "out"), "mine");
}

TEST(OutputFolder, BelowAFileIsTold) {
    const Studio studio;
    writeFile(studio / "file", "mine");
    const Ended ended = run(studio.turntable(2, {"--out", "file/out"}));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, HasSubstr("file/out"));
    EXPECT_EQ(readFile(studio / "file"), "mine");
}

TEST(OutputFolder, ThatTakesNoFilesIsTold) {
    const Studio studio;
    const Ended ended = run(studio.turntable(2, {"--out", "/proc/self"}));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.out, IsEmpty());
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, HasSubstr("cannot write into the output folder /proc/self"));
}

/// The page, and the files that tell of the recording.
bool isBesidePictures(const std::string& name) {
    return name.ends_with(".html") || name.ends_with(".recording") ||
           name.ends_with(".frames.json") || name.ends_with(".journal");
}

/// Every picture that is there is whole, and no half of a file stands beside them.
void expectWholePicturesOnly(const std::filesystem::path& folder) {
    for (const std::string& name : filesIn(folder))
        EXPECT_TRUE(isBesidePictures(name) || readPictureHeader(folder / name).has_value()) << name;
}

/// The count k of "only k of n frames were written".
int framesTold(const std::string& message, int total) {
    std::smatch found;
    const std::regex pattern("quarn: only ([0-9]+) of " + std::to_string(total) +
                             " frames were written to ");
    return std::regex_search(message, found, pattern) ? std::stoi(found[1]) : -1;
}

int picturesIn(const std::filesystem::path& folder) {
    int count = 0;
    for (const std::string& name : filesIn(folder))
        count += !isBesidePictures(name);
    return count;
}

/// The first picture, but the very first, that takes more bytes than all before it.
int firstLargerPicture(const std::filesystem::path& folder, int count) {
    std::uintmax_t largest = std::filesystem::file_size(folder / "house000.png");
    for (int frame = 1; frame < count; ++frame) {
        const std::string name = "house00" + std::to_string(frame) + ".png";
        if (std::filesystem::file_size(folder / name) > largest)
            return frame;
    }
    return -1;
}

TEST(FullDisk, PictureThatCannotBeWrittenIsCountedOutAndTheOthersStayWhole) {
    // A limit on the size of files stands in for the disk: the first picture that needs more than
    // those before it finds none left.
    const Studio studio;
    const auto record = [&](const std::string& folder, unsigned long largest_file) {
        Start start =
            studio.turntable(8, {"--format", "png", "--size", "320x240", "--out", folder});
        start.largest_file = largest_file;
        return run(start);
    };
    ASSERT_EQ(record("all", 0).exit_code, 0);
    const int stopper = firstLargerPicture(studio / "all", 8);
    ASSERT_GT(stopper, 0);
    const auto size =
        std::filesystem::file_size(studio / ("all/house00" + std::to_string(stopper) + ".png"));

    const Ended ended = record("some", size - 1);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_EQ(ended.killed_by, 0);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
    EXPECT_EQ(framesTold(ended.err, 8), stopper);
    EXPECT_THAT(ended.err, HasSubstr("some"));
    EXPECT_THAT(ended.err, HasSubstr("larger than is allowed"));
    EXPECT_EQ(picturesIn(studio / "some"), stopper);
    expectWholePicturesOnly(studio / "some");
    EXPECT_THAT(readFile(studio / "some/house.html"),
                HasSubstr("ImageCount = " + std::to_string(stopper) + ";"));
}

/// A disk of 256 kB where the test may mount one; it is gone with the object.
class SmallDisk {
public:
    explicit SmallDisk(const std::filesystem::path& folder) : m_folder(folder) {
        std::filesystem::create_directory(folder);
        m_is_mounted = mount("tmpfs", folder.c_str(), "tmpfs", 0, "size=256k") == 0;
    }
    ~SmallDisk() {
        if (m_is_mounted)
            umount(m_folder.c_str());
    }
    SmallDisk(const SmallDisk&) = delete;
    SmallDisk& operator=(const SmallDisk&) = delete;

    bool isMounted() const { return m_is_mounted; }

private:
    std::filesystem::path m_folder;
    bool m_is_mounted;
};

TEST(FullDisk, IsToldWithTheNumberOfPicturesThatFitted) {
    const Studio studio;
    const SmallDisk disk(studio / "disk");
    // 160 x 120 pixels of three bytes: at most four such pictures fit. Who may not mount a disk
    // gets files that are limited to less than one picture, and none fits.
    Start start = studio.turntable(30, {"--format", "bmp", "--size", "160x120", "--out", "disk"});
    if (!disk.isMounted())
        start.largest_file = 50000;
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_EQ(ended.killed_by, 0);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
    EXPECT_EQ(framesTold(ended.err, 30), disk.isMounted() ? 4 : 0) << ended.err;
    EXPECT_THAT(ended.err,
                HasSubstr(disk.isMounted() ? "the disk is full" : "larger than is allowed"));
    EXPECT_EQ(picturesIn(studio / "disk"), disk.isMounted() ? 4 : 0);
    expectWholePicturesOnly(studio / "disk");
}

TEST(FullDisk, FormerPicturesOfTheSameNameStayWhole) {
    const Studio studio;
    const auto record = [&](const char* elevation, unsigned long largest_file) {
        Start start =
            studio.turntable(2, {"--format", "bmp", "--size", "160x120", "--elevation", elevation});
        start.largest_file = largest_file;
        return run(start);
    };
    ASSERT_EQ(record("20", 0).exit_code, 0);
    const std::string before = readFile(studio / "out/house000.bmp");
    EXPECT_EQ(record("50", 50000).exit_code, 1);
    EXPECT_EQ(readFile(studio / "out/house000.bmp"), before);
}

TEST(RenderMethod, RecordsPicturesOfTheSizeThatIsAskedFor) {
    for (const std::string mode : {"RenderFull", "RenderPreview"}) {
        const Studio studio;
        const Ended ended =
            run(studio.turntable(2, {"--mode", mode, "--size", "40x24", "--format", "bmp"}));
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_EQ(picturesIn(studio / "out"), 2);
        // 24 bits a pixel behind 54 bytes of headers.
        EXPECT_EQ(std::filesystem::file_size(studio / "out/house000.bmp"), 54U + 40U * 24U * 3U);
    }
}

TEST(RenderMethod, FullDiskIsToldAndNoMoreIsRendered) {
    const Studio studio;
    Start start = studio.turntable(
        100000, {"--mode", "RenderPreview", "--size", "160x120", "--format", "bmp"});
    start.largest_file = 50000; // less than one picture
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
    EXPECT_EQ(framesTold(ended.err, 100000), 0) << ended.err;
    EXPECT_THAT(ended.err, HasSubstr("house000.bmp': the file would be larger than is allowed"));
    EXPECT_EQ(picturesIn(studio / "out"), 0);
}

TEST(RenderMethod, APageThatCannotBeWrittenIsToldWithTheReason) {
    const Studio studio;
    std::filesystem::create_directories(studio / "out/house.html");
    const Ended ended = run(studio.turntable(2, {"--mode", "RenderPreview", "--size", "40x24"}));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
    EXPECT_THAT(ended.err, HasSubstr("all frames were written, but the page out/house.html"));
    EXPECT_THAT(ended.err, testing::Not(HasSubstr("Command:")));
    EXPECT_EQ(picturesIn(studio / "out"), 2);
}

// A program that checks its memory reserves more addresses than any limit allows.
#if !defined(__SANITIZE_ADDRESS__)
TEST(RenderMethod, SizeThatNoMemoryHoldsTellsThatNoFrameWasWritten) {
    const Studio studio;
    Start start = studio.turntable(2, {"--mode", "RenderFull", "--size", "5000x5000"});
    start.largest_memory = 3000000000;
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
    EXPECT_EQ(framesTold(ended.err, 2), 0);
    EXPECT_THAT(ended.err, HasSubstr("A picture of 5000 by 5000 pixels takes"));
    EXPECT_EQ(picturesIn(studio / "out"), 0);
}
#endif

} // namespace
} // namespace quarn::test
