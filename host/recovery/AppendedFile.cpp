#include "host/recovery/AppendedFile.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace quarn {

namespace {

Error reason() {
    return {std::strerror(errno)};
}

} // namespace

AppendedFile::AppendedFile(AppendedFile&& other) noexcept
    : m_descriptor(std::exchange(other.m_descriptor, -1)), m_size(other.m_size) {}

AppendedFile& AppendedFile::operator=(AppendedFile&& other) noexcept {
    std::swap(m_descriptor, other.m_descriptor);
    std::swap(m_size, other.m_size);
    return *this;
}

Result<AppendedFile> AppendedFile::make(const std::filesystem::path& path) {
    AppendedFile file;
    file.m_descriptor =
        open(path.c_str(), O_WRONLY | O_APPEND | O_CREAT | O_EXCL | O_CLOEXEC, 0600);
    if (!file.isOpen())
        return reason();
    return file;
}

Result<void> AppendedFile::append(std::span<const std::uint8_t> bytes) {
    while (!bytes.empty()) {
        const ssize_t written = write(m_descriptor, bytes.data(), bytes.size());
        if (written < 0 && errno == EINTR)
            continue;
        if (written <= 0)
            return reason();
        m_size += static_cast<std::uint64_t>(written);
        bytes = bytes.subspan(static_cast<std::size_t>(written));
    }
    return {};
}

Result<void> AppendedFile::flush() {
    if (fdatasync(m_descriptor) != 0)
        return reason();
    return {};
}

bool AppendedFile::cutTo(std::uint64_t size) {
    if (ftruncate(m_descriptor, static_cast<off_t>(size)) != 0)
        return false;
    m_size = size;
    return true;
}

void AppendedFile::close() {
    if (isOpen())
        ::close(std::exchange(m_descriptor, -1));
    m_size = 0;
}

bool AppendedFile::isAt(const std::filesystem::path& path) const {
    struct stat own {};
    struct stat named {};
    return isOpen() && fstat(m_descriptor, &own) == 0 && lstat(path.c_str(), &named) == 0 &&
           own.st_dev == named.st_dev && own.st_ino == named.st_ino;
}

Result<void> moveOver(const std::filesystem::path& from, const std::filesystem::path& to) {
    if (rename(from.c_str(), to.c_str()) != 0)
        return reason();
    const int folder = open(to.parent_path().c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (folder < 0)
        return {}; // one that may not be read; the file is there
    [[maybe_unused]] const int flushed = fsync(folder); // not every file system can
    close(folder);
    return {};
}

} // namespace quarn
