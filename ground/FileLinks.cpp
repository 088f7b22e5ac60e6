#include "ground/FileLinks.h"

#include <sys/stat.h>
#include <unistd.h>

namespace quarn {

namespace fs = std::filesystem;

namespace {

/// Where anybody may make files, somebody else's link may lead to what is ours.
bool mayFollow(const fs::path& link, const struct stat& status) {
    struct stat folder {};
    const fs::path parent = link.has_parent_path() ? link.parent_path() : fs::path(".");
    if (stat(parent.c_str(), &folder) != 0)
        return false;
    const bool is_for_anybody = (folder.st_mode & S_ISVTX) != 0 && (folder.st_mode & S_IWOTH) != 0;
    return !is_for_anybody || status.st_uid == geteuid() || status.st_uid == folder.st_uid;
}

} // namespace

Result<fs::path> fileBehindLinks(const fs::path& path) {
    constexpr int most_links = 40; // as the system itself follows
    fs::path file = path;
    for (int links = 0; links <= most_links; ++links) {
        struct stat status {};
        if (lstat(file.c_str(), &status) != 0 || !S_ISLNK(status.st_mode))
            return file;
        if (!mayFollow(file, status))
            return Error{"it is a link that another user made in a folder for everybody, which "
                         "is not followed; choose another name"};
        std::error_code error;
        const fs::path next = fs::read_symlink(file, error);
        if (error)
            return Error{error.message()};
        file = file.parent_path() / next;
    }
    return Error{"its symbolic links lead round in a circle; remove them or choose another name"};
}

} // namespace quarn
