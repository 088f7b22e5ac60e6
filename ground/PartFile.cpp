#include "ground/PartFile.h"

#include "ground/ProcessIdentity.h"

#include <cerrno>
#include <charconv>
#include <dirent.h>
#include <fcntl.h>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unistd.h>
#include <utility>

namespace quarn {
namespace {

namespace fs = std::filesystem;

constexpr std::string_view PREFIX = ".quarn-";
constexpr std::string_view SUFFIX = ".part";

std::string nameOf(const ProcessIdentity& writer, int number) {
    return std::string(PREFIX) + writer.host + '-' + std::to_string(writer.pid) + '-' +
           std::to_string(number) + std::string(SUFFIX);
}

/// Takes "-NUMBER" off the end of a text.
std::optional<int> takeNumber(std::string_view& text) {
    const std::size_t dash = text.rfind('-');
    if (dash == text.npos)
        return std::nullopt;
    const std::string_view digits = text.substr(dash + 1);
    text = text.substr(0, dash);
    int number = 0;
    const auto [end, error] = std::from_chars(digits.begin(), digits.end(), number);
    const bool is_number = error == std::errc() && end == digits.end() && number >= 0;
    return is_number ? std::optional(number) : std::nullopt;
}

/// Whose part file has this name; nobody where it is none.
std::optional<ProcessIdentity> writerOf(std::string_view name) {
    if (name.size() < PREFIX.size() + SUFFIX.size() || !name.starts_with(PREFIX) ||
        !name.ends_with(SUFFIX))
        return std::nullopt;
    name.remove_prefix(PREFIX.size());
    name.remove_suffix(SUFFIX.size());
    const std::optional<int> number = takeNumber(name);
    const std::optional<int> pid = number ? takeNumber(name) : std::nullopt;
    if (!pid || name.empty())
        return std::nullopt;
    return ProcessIdentity{std::string(name), *pid, 0};
}

bool isLeft(const fs::path& folder, const char* name) {
    const std::optional<ProcessIdentity> writer = writerOf(name);
    std::error_code error;
    return writer && hasEnded(*writer) &&
           fs::is_regular_file(fs::symlink_status(folder / name, error));
}

} // namespace

PartFile::PartFile(const fs::path& folder, mode_t mode) {
    constexpr int most_tries = 100; // of names that this process's other files have
    const ProcessIdentity writer{hostName(), getpid(), 0};
    for (int number = 0; number < most_tries && m_descriptor < 0; ++number) {
        m_path = folder / nameOf(writer, number);
        m_descriptor = open(m_path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, mode);
        if (m_descriptor < 0 && errno != EEXIST)
            break;
    }
    m_exists = m_descriptor >= 0;
}

PartFile::~PartFile() {
    close();
    if (m_exists)
        unlink(m_path.c_str());
}

bool PartFile::write(std::span<const std::byte> bytes) const {
    while (!bytes.empty()) {
        const ssize_t written = ::write(m_descriptor, bytes.data(), bytes.size());
        if (written < 0 && errno == EINTR)
            continue;
        if (written <= 0)
            return false;
        bytes = bytes.subspan(static_cast<std::size_t>(written));
    }
    return true;
}

bool PartFile::flushToDisk() const {
    return fsync(m_descriptor) == 0;
}

bool PartFile::close() {
    const int descriptor = std::exchange(m_descriptor, -1);
    return descriptor < 0 || ::close(descriptor) == 0;
}

bool PartFile::renameTo(const fs::path& path) {
    m_exists = rename(m_path.c_str(), path.c_str()) != 0;
    return !m_exists;
}

/// A folder of recordings may have many thousand files, so no path is made for those that stay.
void removeLeftParts(const fs::path& folder) {
    const std::unique_ptr<DIR, int (*)(DIR*)> listing(opendir(folder.c_str()), closedir);
    if (!listing)
        return;
    while (const dirent* const entry = readdir(listing.get())) {
        std::error_code ignored;
        if (isLeft(folder, entry->d_name))
            fs::remove(folder / entry->d_name, ignored);
    }
}

} // namespace quarn
