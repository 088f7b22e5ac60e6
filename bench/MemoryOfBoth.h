// The memory of this program and of those that it started, together.
#pragma once

#include <algorithm>
#include <atomic>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <string>
#include <sys/stat.h>
#include <thread>

namespace bench {

/// Bytes of a process in memory, of what others use too its share.
inline double shareOfMemory(const std::string& process) {
    std::ifstream rollup("/proc/" + process + "/smaps_rollup");
    std::string word;
    double kilobytes = 0.0;
    while (rollup >> word)
        if (word == "Pss:") {
            rollup >> kilobytes;
            break;
        }
    return 1024.0 * kilobytes;
}

/// Bytes of the memory that this program shares as a file and that nobody maps.
inline double sharedBlocks() {
    double bytes = 0.0;
    std::error_code gone;
    for (const auto& open : std::filesystem::directory_iterator("/proc/self/fd", gone)) {
        const auto target = std::filesystem::read_symlink(open.path(), gone);
        struct stat status {};
        if (!gone && target.native().starts_with("/memfd:") &&
            stat(open.path().c_str(), &status) == 0)
            bytes += 512.0 * static_cast<double>(status.st_blocks);
    }
    return bytes;
}

inline double memoryOfAll() {
    double bytes = shareOfMemory("self") + sharedBlocks();
    std::error_code gone;
    for (const auto& thread : std::filesystem::directory_iterator("/proc/self/task", gone)) {
        std::ifstream children(thread.path() / "children");
        for (std::string child; children >> child;)
            bytes += shareOfMemory(child);
    }
    return bytes;
}

/// Looks every few milliseconds, for as long as it lives.
class MemoryWatch {
public:
    ~MemoryWatch() { peakMegabytes(); }
    /// Ends the looking.
    /// @return the most that was seen
    double peakMegabytes() {
        m_ends = true;
        if (m_looking.joinable())
            m_looking.join();
        return m_peak / 1e6;
    }

private:
    void look() {
        while (!m_ends) {
            m_peak = std::max(m_peak, memoryOfAll());
            std::this_thread::sleep_for(std::chrono::milliseconds(2));
        }
    }

    double m_peak = 0.0;
    std::atomic<bool> m_ends{false};
    std::thread m_looking{[this] { look(); }};
};

} // namespace bench
