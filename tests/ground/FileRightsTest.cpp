#include "ground/AtomicFile.h"
#include "tests/support/OtherUser.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <array>
#include <cerrno>
#include <cstdint>
#include <sys/stat.h>
#include <sys/xattr.h>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;

constexpr const char* ACCESS_LIST = "system.posix_acl_access";

/// A file "a.txt" that is replaced.
class FileRights : public ::testing::Test {
protected:
    FileRights() { writeFile(path, "old"); }

    static bool replace(const fs::path& file) {
        constexpr std::string_view text = "new";
        return writeFileAtomically(file, std::as_bytes(std::span(text))).ok();
    }
    struct stat status() const {
        struct stat status {};
        EXPECT_EQ(stat(path.c_str(), &status), 0);
        return status;
    }
    mode_t permissions() const { return status().st_mode & 07777; }

    /// Gives the file an access list by which the owner, this user and the owning group may read
    /// and write: version 2, then tag, permissions and id of each entry.
    bool giveAccessListFor(std::uint32_t user) const {
        struct Entry {
            std::uint16_t tag, permissions;
            std::uint32_t id;
        };
        struct List {
            std::uint32_t version = 2;
            std::array<Entry, 5> entries;
        } list;
        constexpr std::uint32_t no_id = 0xFFFFFFFF;
        constexpr std::uint16_t owner = 1, one_user = 2, group = 4, mask = 16, others = 32;
        list.entries = {{{owner, 6, no_id},
                         {one_user, 6, user},
                         {group, 0, no_id},
                         {mask, 6, no_id},
                         {others, 0, no_id}}};
        return setxattr(path.c_str(), ACCESS_LIST, &list, sizeof list, 0) == 0;
    }
    std::string attribute(const char* name) const {
        std::array<char, 256> value{};
        const ssize_t size = getxattr(path.c_str(), name, value.data(), value.size());
        return {value.data(), size > 0 ? static_cast<std::size_t>(size) : 0};
    }

    TempFolder folder;
    const fs::path path = folder / "a.txt";
};

TEST_F(FileRights, OwnerGroupAndPermissionsAreKept) {
    if (!isRoot())
        GTEST_SKIP() << "only root can give a file to another user";
    ASSERT_EQ(chown(path.c_str(), NOBODY, 12345), 0);
    chmod(path.c_str(), 0664);
    ASSERT_TRUE(replace(path));
    EXPECT_EQ(status().st_uid, NOBODY);
    EXPECT_EQ(status().st_gid, 12345U);
    EXPECT_EQ(permissions(), 0664U);
}

TEST_F(FileRights, WhereTheGroupCannotBeKeptNobodyHasMoreThanBefore) {
    if (!isRoot())
        GTEST_SKIP() << "only root can give a file to a group that it is not in";
    fs::permissions(folder.path(), fs::perms::all);
    struct Case {
        mode_t before;
        mode_t after;
    };
    for (const auto& [before, after] :
         {Case{0660, 0600}, {0664, 0644}, {0606, 0600}, {0666, 0666}}) {
        ASSERT_EQ(chown(path.c_str(), NOBODY, 12345), 0);
        chmod(path.c_str(), before);
        ASSERT_TRUE(runAsOrdinaryUser([this] { return replace(path); }));
        EXPECT_EQ(status().st_gid, NOBODY) << "the group of who wrote it";
        EXPECT_EQ(permissions(), after) << std::oct << before;
    }
}

TEST_F(FileRights, ToRunAProgramAsItsOwnerAreNotHandedOn) {
    chmod(path.c_str(), 06755);
    ASSERT_TRUE(replace(path));
    EXPECT_EQ(permissions(), 0755U);
}

TEST_F(FileRights, AccessListAndTheUsersOwnAttributesAreKept) {
    if (!giveAccessListFor(NOBODY) || setxattr(path.c_str(), "user.colour", "red", 3, 0) != 0)
        GTEST_SKIP() << "the disk keeps no attributes";
    const std::string list = attribute(ACCESS_LIST);
    ASSERT_TRUE(replace(path));
    EXPECT_EQ(attribute(ACCESS_LIST), list);
    EXPECT_EQ(attribute("user.colour"), "red");
    EXPECT_EQ(permissions(), 0660U);
}

TEST_F(FileRights, AListThatTheFolderGivesToNewFilesIsNotTakenOver) {
    if (!giveAccessListFor(NOBODY))
        GTEST_SKIP() << "the disk keeps no access lists";
    const std::string list = attribute(ACCESS_LIST);
    ASSERT_EQ(
        setxattr(folder.path().c_str(), "system.posix_acl_default", list.data(), list.size(), 0),
        0);
    ASSERT_EQ(removexattr(path.c_str(), ACCESS_LIST), 0);
    chmod(path.c_str(), 0660);
    ASSERT_TRUE(replace(path));
    EXPECT_EQ(attribute(ACCESS_LIST), "");
}

TEST_F(FileRights, AnotherHardLinkKeepsTheFormerContent) {
    fs::create_hard_link(path, folder / "b.txt");
    ASSERT_TRUE(replace(path));
    EXPECT_EQ(readFile(path), "new");
    EXPECT_EQ(readFile(folder / "b.txt"), "old");
}

} // namespace
} // namespace quarn::test
