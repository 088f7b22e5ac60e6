#include "import/transfer/SharedBlock.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <string>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace quarn {

namespace {

constexpr std::uint64_t BLOCK_BYTES = 512; ///< what stat counts memory in

Error noSharedMemory(int code) {
    const bool is_full = code == ENOSPC || code == EFBIG || code == ENOMEM;
    return {"there is too little shared memory" +
            (is_full ? std::string() : std::string(" (") + std::strerror(code) + ")")};
}

struct stat statusOf(int descriptor) {
    struct stat status {};
    if (fstat(descriptor, &status) != 0)
        status = {};
    return status;
}

} // namespace

Result<SharedBlock> SharedBlock::make() {
    const int descriptor = memfd_create("quarn-model", MFD_CLOEXEC);
    if (descriptor < 0)
        return noSharedMemory(errno);
    return SharedBlock(descriptor);
}

SharedBlock::SharedBlock(SharedBlock&& other) noexcept
    : m_descriptor(std::exchange(other.m_descriptor, -1)) {}

SharedBlock& SharedBlock::operator=(SharedBlock&& other) noexcept {
    std::swap(m_descriptor, other.m_descriptor);
    return *this;
}

SharedBlock::~SharedBlock() {
    if (m_descriptor >= 0)
        close(m_descriptor);
}

Result<void> SharedBlock::append(std::span<const std::uint8_t> bytes) {
    while (!bytes.empty()) {
        const ssize_t count = write(m_descriptor, bytes.data(), bytes.size());
        if (count < 0 && errno == EINTR)
            continue;
        if (count <= 0)
            return noSharedMemory(count < 0 ? errno : ENOSPC);
        bytes = bytes.subspan(static_cast<std::size_t>(count));
    }
    return {};
}

bool SharedBlock::read(std::uint64_t from, std::span<std::uint8_t> bytes) const {
    while (!bytes.empty()) {
        const ssize_t count =
            pread(m_descriptor, bytes.data(), bytes.size(), static_cast<off_t>(from));
        if (count < 0 && errno == EINTR)
            continue;
        if (count <= 0)
            return false;
        from += static_cast<std::uint64_t>(count);
        bytes = bytes.subspan(static_cast<std::size_t>(count));
    }
    return true;
}

void SharedBlock::giveBack(std::uint64_t from, std::uint64_t to) {
    // What cannot be given back now goes with the block.
    [[maybe_unused]] const int given =
        fallocate(m_descriptor, FALLOC_FL_PUNCH_HOLE | FALLOC_FL_KEEP_SIZE,
                  static_cast<off_t>(from), static_cast<off_t>(to - from));
}

std::uint64_t SharedBlock::size() const {
    return static_cast<std::uint64_t>(statusOf(m_descriptor).st_size);
}

std::uint64_t SharedBlock::memory() const {
    return static_cast<std::uint64_t>(statusOf(m_descriptor).st_blocks) * BLOCK_BYTES;
}

} // namespace quarn
