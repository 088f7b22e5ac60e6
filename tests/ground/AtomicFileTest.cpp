#include "ground/AtomicFile.h"

#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <iterator>
#include <sys/stat.h>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;

std::span<const std::byte> bytesOf(std::string_view text) {
    return std::as_bytes(std::span(text.data(), text.size()));
}

std::string textOf(const fs::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

TEST(AtomicFile, ReplacesAFileAndKeepsItsPermissions) {
    const TempFolder folder;
    const fs::path path = folder / "a.txt";
    writeFile(path, "old and longer");
    chmod(path.c_str(), 0640);
    ASSERT_TRUE(writeFileAtomically(path, bytesOf("new"), FileSync::yes).ok());
    EXPECT_EQ(textOf(path), "new");
    struct stat status {};
    ASSERT_EQ(stat(path.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777, 0640U);
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
    EXPECT_THAT(written.message(), ::testing::HasSubstr("not an ordinary file"));
    EXPECT_TRUE(fs::is_character_file("/dev/full"));
}

TEST(AtomicFile, LongestNameThatTheSystemAllowsCanBeWritten) {
    const TempFolder folder;
    EXPECT_TRUE(writeFileAtomically(folder.path() / std::string(255, 'a'), bytesOf("x")).ok());
    const auto written = writeFileAtomically(folder.path() / std::string(256, 'a'), bytesOf("x"));
    ASSERT_FALSE(written.ok());
    EXPECT_THAT(written.message(), ::testing::HasSubstr("the name is too long"));
}

TEST(AtomicFile, PathLongerThanTheSystemTakesIsAnErrorThatSaysSo) {
    const std::string path = "/tmp/" + std::string(5000, '/') + "a";
    const auto written = writeFileAtomically(path.c_str(), bytesOf("x"));
    ASSERT_FALSE(written.ok());
    EXPECT_THAT(written.message(), ::testing::HasSubstr("the name is too long"));
}

TEST(AtomicFile, RelativeNameGoesToTheCurrentFolder) {
    const TempFolder folder;
    const fs::path before = fs::current_path();
    fs::current_path(folder.path());
    const auto written = writeFileAtomically("a.txt", bytesOf("x"));
    fs::current_path(before);
    EXPECT_TRUE(written.ok());
    EXPECT_EQ(textOf(folder.path() / "a.txt"), "x");
}

} // namespace
} // namespace quarn::test
