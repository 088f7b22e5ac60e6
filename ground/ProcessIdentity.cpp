#include "ground/ProcessIdentity.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <cerrno>
#include <csignal>
#include <ctime>
#include <fstream>
#include <sstream>
#include <unistd.h>

namespace quarn {

namespace {

std::string readHostName() {
    std::array<char, 256> name{};
    if (gethostname(name.data(), name.size() - 1) != 0 || name[0] == '\0')
        return "localhost";
    std::string cleaned = name.data();
    for (char& c : cleaned)
        if (std::isalnum(static_cast<unsigned char>(c)) == 0 && c != '.' && c != '-')
            c = '_';
    return cleaned;
}

/// Field 22 of the process's line in /proc; the fields are counted from behind the command's name,
/// which may hold blanks and parentheses.
std::uint64_t startOf(int pid) {
    constexpr int fields_between = 19;
    std::ifstream file("/proc/" + std::to_string(pid) + "/stat");
    std::string line;
    std::getline(file, line);
    const std::size_t name_end = line.rfind(')');
    if (name_end == std::string::npos)
        return 0;
    std::istringstream fields(line.substr(name_end + 1));
    std::string skipped;
    for (int i = 0; i < fields_between; ++i)
        fields >> skipped;
    std::uint64_t ticks = 0;
    fields >> ticks;
    return ticks;
}

} // namespace

const std::string& hostName() {
    static const std::string name = readHostName();
    return name;
}

ProcessIdentity currentProcess() {
    const int pid = getpid();
    return {hostName(), pid, startOf(pid)};
}

double secondsSinceProcessStart() {
    const double ticks_per_s = static_cast<double>(sysconf(_SC_CLK_TCK));
    const std::uint64_t started = startOf(getpid());
    timespec now{};
    if (started == 0 || ticks_per_s <= 0.0 || clock_gettime(CLOCK_BOOTTIME, &now) != 0)
        return 0.0;
    const double now_s = static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) * 1e-9;
    return std::max(0.0, now_s - static_cast<double>(started) / ticks_per_s);
}

bool hasEnded(const ProcessIdentity& process) {
    if (process.host != hostName() || process.pid <= 0)
        return false;
    if (kill(process.pid, 0) != 0 && errno == ESRCH)
        return true;
    const std::uint64_t started = startOf(process.pid);
    return started != 0 && process.started != 0 && started != process.started;
}

} // namespace quarn
