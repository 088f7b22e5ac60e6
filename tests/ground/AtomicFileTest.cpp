#include "ground/AtomicFile.h"

#include "tests/support/OtherUser.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <fcntl.h>
#include <iterator>
#include <linux/fs.h>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;

std::span<const std::byte> bytesOf(std::string_view text) {
    return std::as_bytes(std::span(text.data(), text.size()));
}

mode_t permissionsOf(const fs::path& path) {
    struct stat status {};
    EXPECT_EQ(stat(path.c_str(), &status), 0) << path;
    return status.st_mode & 07777;
}

TEST(AtomicFile, ReplacesAFileAndKeepsItsPermissions) {
    const TempFolder folder;
    const fs::path path = folder / "a.txt";
    writeFile(path, "old and longer");
    chmod(path.c_str(), 0640);
    ASSERT_TRUE(writeFileToDisk(path, bytesOf("new")).ok());
    EXPECT_EQ(readFile(path), "new");
    EXPECT_EQ(permissionsOf(path), 0640U);
    EXPECT_EQ(std::distance(fs::directory_iterator(folder.path()), fs::directory_iterator()), 1);
}

TEST(AtomicFile, NoBytesMakeAnEmptyFile) {
    const TempFolder folder;
    ASSERT_TRUE(writeFileAtomically(folder.path() / "a", {}).ok());
    EXPECT_EQ(fs::file_size(folder.path() / "a"), 0U);
}

TEST(AtomicFile, DeviceIsNotReplaced) {
    const auto written = writeFileAtomically("/dev/full", bytesOf("new"));
    ASSERT_FALSE(written.ok());
    EXPECT_THAT(written.message(), HasSubstr("not an ordinary file"));
    EXPECT_TRUE(fs::is_character_file("/dev/full"));
}

TEST(AtomicFile, LongestNameThatTheSystemAllowsCanBeWritten) {
    const TempFolder folder;
    EXPECT_TRUE(writeFileAtomically(folder.path() / std::string(255, 'a'), bytesOf("x")).ok());
    const auto written = writeFileAtomically(folder.path() / std::string(256, 'a'), bytesOf("x"));
    ASSERT_FALSE(written.ok());
    EXPECT_THAT(written.message(), HasSubstr("the name is too long"));
}

TEST(AtomicFile, PathLongerThanTheSystemTakesIsAnErrorThatSaysSo) {
    const std::string path = "/tmp/" + std::string(5000, '/') + "a";
    const auto written = writeFileAtomically(path.c_str(), bytesOf("x"));
    ASSERT_FALSE(written.ok());
    EXPECT_THAT(written.message(), HasSubstr("the name is too long"));
}

TEST(AtomicFile, RelativeNameGoesToTheCurrentFolder) {
    const TempFolder folder;
    const fs::path before = fs::current_path();
    fs::current_path(folder.path());
    const auto written = writeFileAtomically("a.txt", bytesOf("x"));
    fs::current_path(before);
    EXPECT_TRUE(written.ok());
    EXPECT_EQ(readFile(folder.path() / "a.txt"), "x");
}

// ---- Protected files

TEST(AtomicFile, WriteProtectedFileIsReplacedOnlyWhereThatIsAskedFor) {
    const TempFolder folder;
    const fs::path path = folder / "a.txt";
    writeFile(path, "old");
    chmod(path.c_str(), 0444);
    EXPECT_TRUE(isWriteProtected(path));
    const auto refused = writeFileAtomically(path, bytesOf("new"));
    ASSERT_FALSE(refused.ok());
    EXPECT_THAT(refused.message(), HasSubstr("a.txt': it is write-protected; allow writing"));
    EXPECT_FALSE(writeFileToDisk(path, bytesOf("new")).ok());
    EXPECT_EQ(readFile(path), "old");

    ASSERT_TRUE(writeFileAtomically(path, bytesOf("new"), Protection::overridden).ok());
    EXPECT_EQ(readFile(path), "new");
    EXPECT_EQ(permissionsOf(path), 0444U) << "it stays protected";
}

TEST(AtomicFile, ProtectionIsTheOwnersBitForTheOwnerAndAnybodysForRoot) {
    const TempFolder folder;
    const fs::path path = folder / "a.txt";
    writeFile(path, "old");
    EXPECT_FALSE(isWriteProtected(path));
    EXPECT_FALSE(isWriteProtected(folder / "none.txt"));
    chmod(path.c_str(), 0466);
    EXPECT_TRUE(isWriteProtected(path)) << "its owner may not write it";
    if (!isRoot())
        return;
    ASSERT_EQ(chown(path.c_str(), NOBODY, NOBODY), 0);
    EXPECT_FALSE(isWriteProtected(path));
    chmod(path.c_str(), 0444);
    EXPECT_TRUE(isWriteProtected(path));
}

TEST(AtomicFile, SomebodyElsesFileThatThisUserMayNotWriteIsProtected) {
    if (!isRoot())
        GTEST_SKIP() << "only root can make a file of another user";
    const TempFolder folder;
    const fs::path path = folder / "a.txt";
    writeFile(path, "old");
    chmod(path.c_str(), 0644);
    fs::permissions(folder.path(), fs::perms::all); // anybody may replace the files in it
    EXPECT_TRUE(runAsOrdinaryUser([&] {
        return isWriteProtected(path) && !writeFileAtomically(path, bytesOf("new")).ok() &&
               writeFileAtomically(path, bytesOf("new"), Protection::overridden).ok();
    }));
    EXPECT_EQ(readFile(path), "new");
}

/// A file that the system lets nobody change, root neither, as long as this lives.
class ImmutableFile {
public:
    explicit ImmutableFile(const fs::path& path)
        : m_file(open(path.c_str(), O_RDONLY | O_CLOEXEC)) {
        m_is_set = setFlags(FS_IMMUTABLE_FL);
    }
    ~ImmutableFile() {
        setFlags(0);
        close(m_file);
    }
    ImmutableFile(const ImmutableFile&) = delete;
    ImmutableFile& operator=(const ImmutableFile&) = delete;
    bool isSet() const { return m_is_set; }

private:
    bool setFlags(int flags) const { return ioctl(m_file, FS_IOC_SETFLAGS, &flags) == 0; }
    int m_file;
    bool m_is_set = false;
};

TEST(AtomicFile, FileThatTheSystemLetsNobodyReplaceIsToldAndStays) {
    const TempFolder folder;
    const fs::path path = folder / "a.txt";
    writeFile(path, "old");
    {
        const ImmutableFile immutable(path);
        if (!immutable.isSet())
            GTEST_SKIP() << "the disk, or this user, cannot protect a file so";
        const auto written = writeFileAtomically(path, bytesOf("new"), Protection::overridden);
        ASSERT_FALSE(written.ok());
        EXPECT_THAT(written.message(), HasSubstr("the system does not let it be replaced"));
    }
    EXPECT_EQ(readFile(path), "old");
    EXPECT_EQ(std::distance(fs::directory_iterator(folder.path()), fs::directory_iterator()), 1);
}

// ---- Files that come in pieces

TEST(FileInPieces, HasThemInTheirOrder) {
    const TempFolder folder;
    const auto written = writeFileInPieces(folder / "a.txt", [](const ByteSink& sink) {
        EXPECT_TRUE(sink(bytesOf("one, ")));
        EXPECT_TRUE(sink(bytesOf("two")));
        return Result<void>();
    });
    ASSERT_TRUE(written.ok()) << written.message();
    EXPECT_EQ(readFile(folder / "a.txt"), "one, two");
}

TEST(FileInPieces, IsNotThereWhereTheyEndInAnError) {
    const TempFolder folder;
    writeFile(folder / "a.txt", "old");
    const auto written = writeFileInPieces(folder / "a.txt", [](const ByteSink& sink) {
        sink(bytesOf("new"));
        return Result<void>(Error{"The second piece is lost."});
    });
    EXPECT_EQ(written.message(), "The second piece is lost.");
    EXPECT_EQ(readFile(folder / "a.txt"), "old");
    EXPECT_EQ(std::distance(fs::directory_iterator(folder.path()), fs::directory_iterator()), 1);
}

// ---- Folders that cannot be flushed

TEST(AtomicFile, WhereTheFolderCannotBeFlushedTheFileIsWrittenWithAWarning) {
    const TempFolder folder;
    const fs::path box = folder / "box"; // whose files nobody may list
    fs::create_directory(box);
    if (isRoot()) {
        fs::permissions(folder.path(), fs::perms::all);
        ASSERT_EQ(chown(box.c_str(), NOBODY, NOBODY), 0);
    }
    fs::permissions(box, fs::perms::owner_write | fs::perms::owner_exec);
    EXPECT_TRUE(runAsOrdinaryUser([&] {
        const auto written = writeFileToDisk(box / "a.txt", bytesOf("new"));
        return written.ok() &&
               written.value().warning.find("a.txt' is written, but") != std::string::npos;
    }));
    fs::permissions(box, fs::perms::owner_all);
    EXPECT_EQ(readFile(box / "a.txt"), "new");
    const auto written = writeFileToDisk(folder / "a.txt", bytesOf("new"));
    ASSERT_TRUE(written.ok());
    EXPECT_EQ(written.value().warning, "") << "a folder like any other";
}

} // namespace
} // namespace quarn::test
