#include "ground/AtomicFile.h"

#include "ground/FileLinks.h"
#include "ground/FileRights.h"
#include "ground/PartFile.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace quarn {
namespace {

namespace fs = std::filesystem;

std::string adviceFor(int code) {
    switch (code) {
    case ENOSPC:
    case EDQUOT:
        return "the disk is full; free some space or choose another folder";
    case EFBIG:
        return "the file would be larger than is allowed here";
    case EACCES:
    case EPERM:
        return "there is no permission; choose another folder";
    case EROFS:
        return "the disk is read-only; choose another folder";
    case ENAMETOOLONG:
        return "the name is too long";
    case ENOENT:
    case ENOTDIR:
        return "its folder does not exist";
    default:
        return std::strerror(code);
    }
}

/// Where the bytes go.
struct Target {
    fs::path asked; ///< as the caller names it, perhaps a link
    fs::path file;
    struct stat present {};
    bool replaces = false;

    fs::path folder() const { return file.has_parent_path() ? file.parent_path() : fs::path("."); }
};

Error cannotWrite(const fs::path& path, const std::string& why) {
    return {"Cannot write '" + path.string() + "': " + why + "."};
}

Error cannotWrite(const Target& target, const std::string& why) {
    const bool is_link = target.file != target.asked;
    return cannotWrite(target.asked,
                       is_link ? "it is a link to '" + target.file.string() + "': " + why : why);
}

Result<Target> targetOf(const fs::path& path, Protection protection) {
    Target target{path, path};
    target.replaces = stat(path.c_str(), &target.present) == 0;
    const mode_t mode = target.present.st_mode;
    if (target.replaces && !S_ISREG(mode))
        return cannotWrite(path, S_ISDIR(mode) ? "there is a folder of this name"
                                               : "it is not an ordinary file");
    Result<fs::path> file = fileBehindLinks(path);
    if (!file)
        return cannotWrite(path, file.message());
    target.file = std::move(file.value());
    if (target.replaces && protection == Protection::respected && isWriteProtected(target.file))
        return cannotWrite(target,
                           "it is write-protected; allow writing to it or choose another name");
    return target;
}

enum class Flush { no, yes };

using Fill = std::function<Result<void>(const ByteSink&)>;

Fill fillWith(std::span<const std::byte> bytes) {
    return [bytes](const ByteSink& sink) {
        sink(bytes);
        return Result<void>();
    };
}

Result<void> write(const Target& target, const Fill& fill, Flush flush) {
    constexpr mode_t of_new_files = 0666; // less what the user's mask takes away
    constexpr mode_t of_nobody_else = 0600;
    PartFile part(target.folder(), target.replaces ? of_nobody_else : of_new_files);
    int code = part.isOpen() ? 0 : errno;
    if (part.isOpen() && target.replaces)
        takeOverRights(target.file, target.present, part.descriptor());
    const ByteSink sink = [&](std::span<const std::byte> bytes) {
        if (code == 0 && !part.write(bytes))
            code = errno;
        return code == 0;
    };
    const Result<void> filled = code == 0 ? fill(sink) : Result<void>();
    if (code == 0 && !filled)
        return filled;
    if (code == 0 && ((flush == Flush::yes && !part.flushToDisk()) || !part.close()))
        code = errno;
    if (code != 0)
        return cannotWrite(target, adviceFor(code));
    if (part.renameTo(target.file))
        return {};
    const bool is_forbidden = errno == EPERM || errno == EACCES;
    return cannotWrite(target, target.replaces && is_forbidden
                                   ? "the system does not let it be replaced; choose another name"
                                   : adviceFor(errno));
}

/// @return why it could not be done; empty when it was
std::string flushFolder(const fs::path& folder) {
    const int descriptor = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (descriptor < 0)
        return std::strerror(errno);
    // On some disks folders need no flushing, and on others they cannot change.
    const bool flushed = fsync(descriptor) == 0 || errno == EINVAL || errno == EROFS;
    const std::string why = flushed ? "" : std::strerror(errno);
    close(descriptor);
    return why;
}

} // namespace

Result<void> writeFileAtomically(const fs::path& path, std::span<const std::byte> bytes,
                                 Protection protection) {
    const Result<Target> target = targetOf(path, protection);
    return target ? write(target.value(), fillWith(bytes), Flush::no) : target.error();
}

Result<void> writeFileInPieces(const fs::path& path, const Fill& fill, Protection protection) {
    const Result<Target> target = targetOf(path, protection);
    return target ? write(target.value(), fill, Flush::no) : target.error();
}

Result<WrittenFile> writeFileToDisk(const fs::path& path, std::span<const std::byte> bytes,
                                    Protection protection) {
    const Result<Target> target = targetOf(path, protection);
    if (!target)
        return target.error();
    const fs::path folder = target.value().folder();
    removeLeftParts(folder);
    if (const Result<void> written = write(target.value(), fillWith(bytes), Flush::yes); !written)
        return written.error();
    const std::string trouble = flushFolder(folder);
    if (trouble.empty())
        return WrittenFile();
    return WrittenFile{"'" + path.string() +
                       "' is written, but its folder could not be flushed to the disk (" + trouble +
                       "): if the machine stops within moments, the file of before may be back."};
}

bool isWriteProtected(const fs::path& path) {
    struct stat status {};
    if (stat(path.c_str(), &status) != 0 || !S_ISREG(status.st_mode))
        return false;
    if (geteuid() == 0) {
        const mode_t wanted = status.st_uid == 0 ? S_IWUSR : S_IWUSR | S_IWGRP | S_IWOTH;
        return (status.st_mode & wanted) == 0;
    }
    return faccessat(AT_FDCWD, path.c_str(), W_OK, AT_EACCESS) != 0 && errno == EACCES;
}

} // namespace quarn
