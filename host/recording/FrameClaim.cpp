#include "host/recording/FrameClaim.h"

#include "ground/FileBytes.h"
#include "host/recording/FrameNames.h"

#include <cerrno>
#include <fcntl.h>
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

/// A claim that names nobody was made by a program that was killed in that moment, or on a disk
/// that is full.
bool isHeld(const std::string& owner, const FrameClaim::Claimer& claimer) {
    return !owner.empty() && owner.find('/') == owner.npos && claimer.is_alive(owner);
}

/// Moves a claim aside that nobody holds any more. Another program may have done so in the same
/// moment, and made its own: what was moved is looked at, and goes back where it is that one.
void removeDead(const fs::path& file, const std::string& owner,
                const FrameClaim::Claimer& claimer) {
    const fs::path aside = claimer.journal.native() + ".aside";
    if (rename(file.c_str(), aside.c_str()) != 0)
        return;
    if (ownerOf(aside) != owner)
        (void)link(aside.c_str(), file.c_str());
    unlink(aside.c_str());
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
        if (isHeld(*owner, claimer))
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
