#include "host/recovery/RecoveryGlance.h"

#include "host/recovery/RecoveryChunks.h"
#include "kelmar/KM_LittleEndian.h"

#include <array>
#include <cstdint>
#include <fcntl.h>
#include <span>
#include <sys/stat.h>
#include <unistd.h>

namespace quarn {

namespace {

/// More than the picture of any writer takes.
constexpr std::uint64_t MOST_PICTURE = 4 << 20;

class HeadReader {
public:
    explicit HeadReader(const std::filesystem::path& file)
        : m_descriptor(open(file.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC)) {
        struct stat status {};
        if (m_descriptor < 0 || fstat(m_descriptor, &status) != 0 || !S_ISREG(status.st_mode))
            return;
        m_size = static_cast<std::uint64_t>(status.st_size);
        m_glance.kept_at = std::chrono::system_clock::from_time_t(status.st_mtime);
    }
    ~HeadReader() {
        if (m_descriptor >= 0)
            close(m_descriptor);
    }
    HeadReader(const HeadReader&) = delete;
    HeadReader& operator=(const HeadReader&) = delete;

    RecoveryGlance read() {
        while (readChunk())
            ;
        return std::move(m_glance);
    }

private:
    bool readAt(std::uint64_t place, std::span<std::uint8_t> bytes) const {
        const ssize_t count =
            pread(m_descriptor, bytes.data(), bytes.size(), static_cast<off_t>(place));
        return count >= 0 && static_cast<std::size_t>(count) == bytes.size();
    }

    /// Goes over a chunk. @return false when there is no further whole one
    bool readChunk() {
        std::array<std::uint8_t, 16> head{}; // id, length, check sequence
        if (m_place + head.size() > m_size || !readAt(m_place, head))
            return false;
        const auto id = kelmar::fromLittleEndian<std::uint32_t>(head.data());
        const auto length = kelmar::fromLittleEndian<std::uint64_t>(head.data() + 4);
        const std::uint64_t payload = m_place + head.size();
        if (length > m_size - payload)
            return false;
        if (id == chunk::STATE)
            readTime(payload, length);
        if (id == chunk::PICTURE)
            readPicture(payload, length);
        m_place = payload + length;
        return true;
    }

    void readTime(std::uint64_t place, std::uint64_t length) {
        std::array<std::uint8_t, 8> bytes{};
        if (length < bytes.size() || !readAt(place, bytes))
            return;
        const auto number = kelmar::fromLittleEndian<std::uint64_t>(bytes.data());
        if (const auto time = timeOf(static_cast<std::int64_t>(number)))
            m_glance.kept_at = *time;
    }

    void readPicture(std::uint64_t place, std::uint64_t length) {
        if (length > MOST_PICTURE)
            return;
        std::vector<std::byte> png(length);
        if (readAt(place, {reinterpret_cast<std::uint8_t*>(png.data()), png.size()}))
            m_glance.picture = std::move(png);
    }

    int m_descriptor;
    std::uint64_t m_size = 0;
    std::uint64_t m_place = RECOVERY_BEGINNING_SIZE;
    RecoveryGlance m_glance;
};

} // namespace

RecoveryGlance glanceAt(const std::filesystem::path& recovery) {
    return HeadReader(recovery).read();
}

} // namespace quarn
