#include "ground/FreeMemory.h"

#include <algorithm>
#include <fstream>
#include <limits>
#include <string>
#include <sys/resource.h>
#include <unistd.h>

namespace quarn {

namespace {

constexpr std::uint64_t unlimited_bytes = std::numeric_limits<std::uint64_t>::max();

std::uint64_t freeInMachine() {
    std::ifstream file("/proc/meminfo");
    std::string name;
    std::uint64_t kilobytes = 0;
    std::string rest;
    while (file >> name >> kilobytes && std::getline(file, rest))
        if (name == "MemAvailable:")
            return kilobytes * 1024;
    return unlimited_bytes;
}

/// The number in a file of the control group; nothing else counts ("max").
std::uint64_t groupNumber(const char* file, std::uint64_t otherwise) {
    std::uint64_t number = 0;
    return std::ifstream(file) >> number ? number : otherwise;
}

std::uint64_t freeInGroup() {
    const std::uint64_t limit = groupNumber("/sys/fs/cgroup/memory.max", unlimited_bytes);
    const std::uint64_t used = groupNumber("/sys/fs/cgroup/memory.current", 0);
    if (limit == unlimited_bytes)
        return unlimited_bytes;
    return limit > used ? limit - used : 0;
}

/// What the limit of the process leaves (`ulimit -v`).
std::uint64_t freeInProcess() {
    rlimit limit{};
    if (getrlimit(RLIMIT_AS, &limit) != 0 || limit.rlim_cur == RLIM_INFINITY)
        return unlimited_bytes;
    std::uint64_t pages = 0;
    std::ifstream("/proc/self/statm") >> pages;
    const std::uint64_t used = pages * static_cast<std::uint64_t>(sysconf(_SC_PAGESIZE));
    return limit.rlim_cur > used ? limit.rlim_cur - used : 0;
}

} // namespace

std::uint64_t freeMemory() {
    return std::min({freeInMachine(), freeInGroup(), freeInProcess()});
}

std::string gigabyteText(std::uint64_t bytes) {
    const std::uint64_t tenths = (bytes * 10 + (1ULL << 29)) >> 30;
    return std::to_string(tenths / 10) + "." + std::to_string(tenths % 10) + " GB";
}

} // namespace quarn
