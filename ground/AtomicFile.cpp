#include "ground/AtomicFile.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <string>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace quarn {
namespace {

namespace fs = std::filesystem;

Error cannotWrite(const fs::path& path, const std::string& why) {
    return {"Cannot write '" + path.string() + "': " + why + "."};
}

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

/// A file under a temporary name, which goes away unless it is renamed.
class PartFile {
public:
    explicit PartFile(const fs::path& folder) {
        constexpr int most_tries = 100; // of names that a killed program may have left
        for (int i = 0; i < most_tries && m_descriptor < 0; ++i) {
            m_path =
                folder / (".quarn-" + std::to_string(getpid()) + "-" + std::to_string(i) + ".part");
            m_descriptor = open(m_path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
            if (m_descriptor < 0 && errno != EEXIST) {
                break;
            }
        }
        m_exists = m_descriptor >= 0;
    }

    PartFile(const PartFile&) = delete;
    PartFile& operator=(const PartFile&) = delete;

    ~PartFile() {
        close();
        if (m_exists) {
            unlink(m_path.c_str());
        }
    }

    bool isOpen() const { return m_descriptor >= 0; }

    void setPermissionsOf(const struct stat& file) const {
        if (fchmod(m_descriptor, file.st_mode & 07777) != 0) {
            return; // a file system without permissions; the content counts
        }
    }

    bool write(std::span<const std::byte> bytes) const {
        while (!bytes.empty()) {
            const ssize_t written = ::write(m_descriptor, bytes.data(), bytes.size());
            if (written < 0 && errno == EINTR) {
                continue;
            }
            if (written <= 0) {
                return false;
            }
            bytes = bytes.subspan(static_cast<std::size_t>(written));
        }
        return true;
    }

    bool flushToDisk() const { return fsync(m_descriptor) == 0; }

    /// False where the last bytes could not be written.
    bool close() {
        const int descriptor = std::exchange(m_descriptor, -1);
        return descriptor < 0 || ::close(descriptor) == 0;
    }

    bool renameTo(const fs::path& path) {
        m_exists = rename(m_path.c_str(), path.c_str()) != 0;
        return !m_exists;
    }

private:
    fs::path m_path;
    int m_descriptor = -1;
    bool m_exists = false;
};

bool flushFolder(const fs::path& folder) {
    const int descriptor = open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (descriptor < 0) {
        return false;
    }
    const bool flushed = fsync(descriptor) == 0 || errno == EINVAL || errno == EROFS;
    close(descriptor);
    return flushed;
}

} // namespace

Result<void> writeFileAtomically(const fs::path& path, std::span<const std::byte> bytes,
                                 FileSync sync) {
    const auto failure = [&path] { return cannotWrite(path, adviceFor(errno)); };
    struct stat present {};
    const bool replaces = stat(path.c_str(), &present) == 0;
    if (replaces && !S_ISREG(present.st_mode)) {
        return cannotWrite(path, S_ISDIR(present.st_mode) ? "there is a folder of this name"
                                                          : "it is not an ordinary file");
    }
    const fs::path folder = path.has_parent_path() ? path.parent_path() : fs::path(".");
    PartFile part(folder);
    if (!part.isOpen()) {
        return failure();
    }
    if (replaces) {
        part.setPermissionsOf(present);
    }
    const bool wrote =
        part.write(bytes) && (sync == FileSync::no || part.flushToDisk()) && part.close();
    if (!wrote || !part.renameTo(path)) {
        return failure();
    }
    if (sync == FileSync::yes && !flushFolder(folder)) {
        return failure();
    }
    return {};
}

} // namespace quarn
