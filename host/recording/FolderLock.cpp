#include "host/recording/FolderLock.h"

#include <cerrno>
#include <chrono>
#include <fcntl.h>
#include <sys/file.h>
#include <thread>
#include <unistd.h>

namespace quarn {

namespace {

/// Whoever has the folder locked for longer is held up, and not waited for.
constexpr int most_tries = 50;
constexpr std::chrono::milliseconds between_tries{10};

} // namespace

FolderLock::FolderLock(const std::filesystem::path& folder)
    : m_descriptor(open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC)) {
    for (int tries = 0; m_descriptor >= 0 && tries < most_tries; ++tries) {
        if (flock(m_descriptor, LOCK_EX | LOCK_NB) == 0 || errno != EWOULDBLOCK)
            return;
        std::this_thread::sleep_for(between_tries);
    }
}

FolderLock::~FolderLock() {
    if (m_descriptor >= 0)
        close(m_descriptor);
}

} // namespace quarn
