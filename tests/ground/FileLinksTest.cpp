#include "ground/AtomicFile.h"
#include "tests/support/OtherUser.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;

std::span<const std::byte> bytesOf(std::string_view text) {
    return std::as_bytes(std::span(text.data(), text.size()));
}

/// A folder `here` with links into a folder `there`.
class FileLinks : public ::testing::Test {
protected:
    FileLinks() {
        fs::create_directory(here);
        fs::create_directory(there);
    }

    static std::string faultOf(const fs::path& path) {
        const auto written = writeFileAtomically(path, bytesOf("new"));
        return written ? "written" : written.message();
    }
    static long filesIn(const fs::path& folder) {
        return std::distance(fs::directory_iterator(folder), fs::directory_iterator());
    }

    TempFolder folder;
    const fs::path here = folder / "here";
    const fs::path there = folder / "there";
};

TEST_F(FileLinks, AreKeptAndWhatTheyLeadToIsReplaced) {
    writeFile(there / "a.txt", "old");
    fs::create_symlink("../there/a.txt", here / "second");
    fs::create_symlink(here / "second", here / "first");
    ASSERT_EQ(faultOf(here / "first"), "written");
    EXPECT_EQ(fs::read_symlink(here / "first"), here / "second");
    EXPECT_EQ(fs::read_symlink(here / "second"), "../there/a.txt");
    EXPECT_EQ(readFile(there / "a.txt"), "new");
    EXPECT_EQ(filesIn(here), 2);
    EXPECT_EQ(filesIn(there), 1);
}

TEST_F(FileLinks, ToAFileThatIsNotThereMakeIt) {
    fs::create_symlink("../there/a.txt", here / "link");
    ASSERT_EQ(faultOf(here / "link"), "written");
    EXPECT_TRUE(fs::is_symlink(here / "link"));
    EXPECT_EQ(readFile(there / "a.txt"), "new");
}

TEST_F(FileLinks, TheTemporaryFileStandsBesideTheTarget) {
    writeFile(there / "a.txt", "old");
    fs::create_symlink(there / "a.txt", here / "link");
    if (isRoot()) {
        fs::permissions(folder.path(), fs::perms::all);
        for (const fs::path& each : {there, there / "a.txt"})
            ASSERT_EQ(chown(each.c_str(), NOBODY, NOBODY), 0);
    }
    fs::permissions(here, fs::perms::owner_read | fs::perms::owner_exec | fs::perms::others_exec);
    EXPECT_TRUE(runAsOrdinaryUser([&] { return faultOf(here / "link") == "written"; }))
        << "nothing is made beside the link";
    fs::permissions(here, fs::perms::owner_all);
}

TEST_F(FileLinks, InACircleAreTold) {
    fs::create_symlink("second", here / "first");
    fs::create_symlink("first", here / "second");
    EXPECT_THAT(faultOf(here / "first"), HasSubstr("first': its symbolic links lead round"));
    EXPECT_EQ(filesIn(here), 2);
}

TEST_F(FileLinks, IntoAFolderThatIsNotThereAreToldWithTheTarget) {
    fs::create_symlink("../none/a.txt", here / "link");
    EXPECT_THAT(faultOf(here / "link"),
                HasSubstr("here/../none/a.txt': its folder does not exist"));
    EXPECT_TRUE(fs::is_symlink(here / "link"));
}

TEST_F(FileLinks, ToAFolderOrADeviceAreRefused) {
    fs::create_symlink(there, here / "folder");
    fs::create_symlink("/dev/full", here / "device");
    EXPECT_THAT(faultOf(here / "folder"), HasSubstr("there is a folder of this name"));
    EXPECT_THAT(faultOf(here / "device"), HasSubstr("it is not an ordinary file"));
}

TEST_F(FileLinks, ToAProtectedFileDoNotGetAroundItsProtection) {
    writeFile(there / "a.txt", "old");
    fs::permissions(there / "a.txt", fs::perms::owner_read);
    fs::create_symlink(there / "a.txt", here / "link");
    EXPECT_TRUE(isWriteProtected(here / "link"));
    EXPECT_THAT(faultOf(here / "link"), HasSubstr("there/a.txt': it is write-protected"));
    EXPECT_EQ(readFile(there / "a.txt"), "old");
}

TEST_F(FileLinks, OfAnotherUserInAFolderForEverybodyAreNotFollowed) {
    if (!isRoot())
        GTEST_SKIP() << "only root can make a link of another user";
    writeFile(there / "a.txt", "old");
    fs::create_symlink(there / "a.txt", here / "link");
    ASSERT_EQ(lchown((here / "link").c_str(), NOBODY, NOBODY), 0);
    EXPECT_EQ(faultOf(here / "link"), "written") << "a folder that is this user's alone";
    writeFile(there / "a.txt", "old");
    fs::permissions(here, fs::perms::all | fs::perms::sticky_bit);
    EXPECT_THAT(faultOf(here / "link"), HasSubstr("a link that another user made"));
    EXPECT_EQ(readFile(there / "a.txt"), "old");
}

} // namespace
} // namespace quarn::test
