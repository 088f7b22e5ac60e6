#include "host/recording/FrameClaim.h"

#include "ground/FileBytes.h"
#include "host/recording/FrameNames.h"

#include <cerrno>
#include <cstdint>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace quarn {

namespace {

namespace fs = std::filesystem;

constexpr std::size_t LONGEST_NAME_BYTES = 4096;

enum class Made { yes, is_there, never };

Made make(const fs::path& file, const std::string& owner) {
    const int descriptor = open(file.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
    if (descriptor < 0)
        return errno == EEXIST ? Made::is_there : Made::never;
    const bool is_written =
        write(descriptor, owner.data(), owner.size()) == static_cast<ssize_t>(owner.size());
    close(descriptor);
    if (is_written)
        return Made::yes;
    unlink(file.c_str());
    return Made::never;
}

/// The journal's name in a claim; nothing where the claim is gone.
std::optional<std::string> ownerOf(const fs::path& file) {
    const auto read = readFileBytes(file, LONGEST_NAME_BYTES);
    if (!read)
        return std::nullopt;
    const auto bytes = read.value().bytes();
    return std::string(reinterpret_cast<const char*>(bytes.data()), bytes.size());
}

/// The time of the disk of a file's last change of any kind; that of its content is kept by links.
std::optional<std::int64_t> changeSecondsOf(const fs::path& file) {
    struct stat status {};
    return stat(file.c_str(), &status) == 0 ? std::optional<std::int64_t>(status.st_ctim.tv_sec)
                                            : std::nullopt;
}

/// Whether a file was changed longer ago than anything here takes.
bool isOld(const fs::path& file, const FrameClaim::Claimer& claimer) {
    constexpr std::int64_t LONGEST_MOMENT_S = 10;
    (void)utimensat(AT_FDCWD, claimer.journal.c_str(), nullptr, 0);
    const auto now_s = changeSecondsOf(claimer.journal);
    const auto changed_s = changeSecondsOf(file);
    return now_s && changed_s && *now_s - *changed_s > LONGEST_MOMENT_S;
}

/// A claim that names nobody is being made this moment, or was made by a program that was killed
/// then.
bool isHeld(const fs::path& file, const std::string& owner, const FrameClaim::Claimer& claimer) {
    if (owner.empty())
        return !isOld(file, claimer);
    return owner.find('/') == owner.npos && claimer.is_alive(owner);
}

/// Removes a claim that nobody holds any more. Many may want to at once, and one of them may have
/// made its own in that place already: the one whose link is made looks at what it has linked, and
/// alone may remove it.
void removeDead(const fs::path& file, const std::string& owner,
                const FrameClaim::Claimer& claimer) {
    const fs::path mark = file.native() + ".dead";
    if (link(file.c_str(), mark.c_str()) != 0) {
        if (errno == EEXIST && isOld(mark, claimer))
            unlink(mark.c_str()); // who made it was killed then
        else if (errno != EEXIST && errno != ENOENT)
            unlink(file.c_str()); // the disk has no links: then two may meet for once
        return;
    }
    if (ownerOf(mark) == owner)
        unlink(file.c_str());
    unlink(mark.c_str());
}

} // namespace

std::optional<FrameClaim> FrameClaim::take(const fs::path& file, const Claimer& claimer) {
    constexpr int MOST_TRIES = 5; // others may take and leave it meanwhile
    const std::string name = claimer.journal.filename().native();
    for (int tries = 0; tries < MOST_TRIES; ++tries) {
        const Made made = make(file, name);
        if (made != Made::is_there)
            return FrameClaim(made == Made::yes ? file : fs::path(), name);
        const auto owner = ownerOf(file);
        if (!owner)
            continue;
        if (isHeld(file, *owner, claimer))
            return std::nullopt;
        removeDead(file, *owner, claimer);
    }
    return std::nullopt;
}

FrameClaim::~FrameClaim() {
    // One that was held up for longer than its lease may have lost it.
    if (!m_file.empty() && ownerOf(m_file) == m_owner)
        unlink(m_file.c_str());
}

std::string claimName(const std::string& animation, int frame) {
    return FrameNames{animation, "claim"}.fileName(frame);
}

} // namespace quarn
