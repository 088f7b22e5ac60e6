#include "ground/FileRights.h"

#include <cstring>
#include <sys/xattr.h>
#include <unistd.h>
#include <vector>

namespace quarn {
namespace {

namespace fs = std::filesystem;

constexpr const char* ACCESS_LIST = "system.posix_acl_access";
constexpr const char* OF_THE_USER = "user.";

/// The value of an attribute, or with a null name the list of names; empty where there is none.
std::vector<char> attributeOf(const fs::path& file, const char* name) {
    const auto ask = [&](char* bytes, std::size_t size) {
        return name ? getxattr(file.c_str(), name, bytes, size)
                    : listxattr(file.c_str(), bytes, size);
    };
    const ssize_t size = ask(nullptr, 0);
    std::vector<char> bytes(size > 0 ? static_cast<std::size_t>(size) : 0);
    const ssize_t read = bytes.empty() ? 0 : ask(bytes.data(), bytes.size());
    bytes.resize(read > 0 ? static_cast<std::size_t>(read) : 0);
    return bytes;
}

bool copyAttribute(const fs::path& former, int descriptor, const char* name) {
    const std::vector<char> value = attributeOf(former, name);
    return fsetxattr(descriptor, name, value.data(), value.size(), 0) == 0;
}

/// @param with_list  whether the access list is copied too
/// @return whether the new file has the access list of the former one, be it that there is none
bool copyAttributes(const fs::path& former, int descriptor, bool with_list) {
    const std::vector<char> names = attributeOf(former, nullptr);
    bool has_list = true;
    for (std::size_t at = 0; at < names.size(); at += std::strlen(&names[at]) + 1) {
        const char* const name = &names[at];
        if (std::strcmp(name, ACCESS_LIST) == 0)
            has_list = with_list && copyAttribute(former, descriptor, name);
        else if (std::strncmp(name, OF_THE_USER, std::strlen(OF_THE_USER)) == 0)
            (void)copyAttribute(former, descriptor, name); // a disk without them; the bytes count
    }
    return has_list;
}

/// Permissions for a file whose group, or the list of others that the group's bits stood for, is
/// another one: who changes between the group and all others has what both had.
mode_t withoutItsGroup(mode_t mode) {
    const mode_t both = mode & (mode >> 3) & S_IRWXO;
    return (mode & S_IRWXU) | (both << 3) | both;
}

} // namespace

void takeOverRights(const fs::path& former, const struct stat& status, int descriptor) {
    constexpr auto same_owner = static_cast<uid_t>(-1);
    constexpr auto same_group = static_cast<gid_t>(-1);
    // Where the owner may not be kept the file becomes this user's, who wrote it.
    [[maybe_unused]] const int owner = fchown(descriptor, status.st_uid, same_group);
    const bool keeps_group = fchown(descriptor, same_owner, status.st_gid) == 0;
    (void)fremovexattr(descriptor, ACCESS_LIST); // that the folder gives to new files
    const bool keeps_list = copyAttributes(former, descriptor, keeps_group);
    const mode_t mode = status.st_mode & (S_IRWXU | S_IRWXG | S_IRWXO);
    // On a disk without permissions it stays as it was made.
    [[maybe_unused]] const int permissions =
        fchmod(descriptor, keeps_group && keeps_list ? mode : withoutItsGroup(mode));
}

} // namespace quarn
