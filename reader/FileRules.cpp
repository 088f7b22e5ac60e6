#include "reader/FileRules.h"

#include <array>
#include <cstdint>
#include <fcntl.h>
#include <linux/landlock.h>
#include <string>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace quarn {

namespace {

namespace fs = std::filesystem;

/// The attributes of a set of rules of the kernel's later versions, which its older headers lack.
struct RuleSet {
    std::uint64_t files = 0;
    std::uint64_t network = 0;
    std::uint64_t scope = 0;
};

/// How many bits each part of the rules has, by version of the kernel's interface: 13 to 16 rights
/// of files; binding and connecting; abstract sockets and signals.
constexpr std::array<int, 6> FILE_BITS = {0, 13, 14, 15, 15, 16};
constexpr int NETWORK_VERSION = 4;
constexpr int SCOPE_VERSION = 6;
constexpr std::uint64_t ALL_OF_TWO = 3;

constexpr std::uint64_t READING = LANDLOCK_ACCESS_FS_READ_FILE | LANDLOCK_ACCESS_FS_READ_DIR;

/// What libraries open while they work: other libraries and their data, the names of characters,
/// the time zone, how many processors there are.
constexpr const char* FOR_LIBRARIES[] = {
    "/usr/lib",  "/usr/lib64",   "/usr/local/lib",         "/lib",
    "/lib64",    "/usr/share",   "/etc/ld.so.cache",       "/etc/localtime",
    "/dev/null", "/dev/urandom", "/sys/devices/system/cpu"};

int makeRules() {
    const auto version = static_cast<int>(
        syscall(SYS_landlock_create_ruleset, nullptr, 0, LANDLOCK_CREATE_RULESET_VERSION));
    if (version < 1)
        return -1;
    const auto known = static_cast<std::size_t>(version) < FILE_BITS.size()
                           ? FILE_BITS[static_cast<std::size_t>(version)]
                           : FILE_BITS.back();
    const RuleSet rules = {(std::uint64_t{1} << known) - 1,
                           version >= NETWORK_VERSION ? ALL_OF_TWO : 0,
                           version >= SCOPE_VERSION ? ALL_OF_TWO : 0};
    const std::size_t size = version >= SCOPE_VERSION     ? sizeof(RuleSet)
                             : version >= NETWORK_VERSION ? offsetof(RuleSet, scope)
                                                          : offsetof(RuleSet, network);
    return static_cast<int>(syscall(SYS_landlock_create_ruleset, &rules, size, 0));
}

/// What is not there needs no rule.
void allowReading(int rules, const fs::path& path) {
    const int place = open(path.c_str(), O_PATH | O_CLOEXEC);
    if (place < 0)
        return;
    struct stat status {};
    const bool is_folder = fstat(place, &status) == 0 && S_ISDIR(status.st_mode);
    const landlock_path_beneath_attr rule = {
        .allowed_access = is_folder ? READING : std::uint64_t{LANDLOCK_ACCESS_FS_READ_FILE},
        .parent_fd = place};
    syscall(SYS_landlock_add_rule, rules, LANDLOCK_RULE_PATH_BENEATH, &rule, 0);
    close(place);
}

/// The installation that this program belongs to has modules for some formats.
fs::path ownLibraries() {
    std::error_code none;
    return fs::read_symlink("/proc/self/exe", none).parent_path().parent_path() / "lib";
}

} // namespace

bool restrictFiles(const fs::path& model) {
    const int rules = makeRules();
    if (rules < 0)
        return false;
    std::error_code none;
    allowReading(rules, fs::absolute(model, none).parent_path());
    allowReading(rules, model); // which may be a link to elsewhere
    allowReading(rules, ownLibraries());
    for (const char* const path : FOR_LIBRARIES)
        allowReading(rules, path);
    const bool is_restricted = syscall(SYS_landlock_restrict_self, rules, 0) == 0;
    close(rules);
    return is_restricted;
}

} // namespace quarn
