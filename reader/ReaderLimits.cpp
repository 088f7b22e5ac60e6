#include "reader/ReaderLimits.h"

#include <algorithm>
#include <csignal>
#include <sys/prctl.h>
#include <sys/resource.h>

namespace quarn {

namespace {

/// What is asked for and mostly not used: a large stack (512 MB), those of other threads, the
/// program's own data.
constexpr std::uint64_t RESERVED_BYTES = std::uint64_t{1} << 30;
constexpr rlim_t MOST_OPEN_FILES = 64;

#if defined(__SANITIZE_ADDRESS__)
constexpr bool KEEPS_BOOKS_OF_MEMORY = true; // in terabytes of addresses
#elif defined(__has_feature)
constexpr bool KEEPS_BOOKS_OF_MEMORY = __has_feature(address_sanitizer);
#else
constexpr bool KEEPS_BOOKS_OF_MEMORY = false;
#endif

/// A limit that is stricter already stays.
void limit(__rlimit_resource what, rlim_t most) {
    rlimit limits{};
    if (getrlimit(what, &limits) != 0)
        return;
    limits.rlim_max = std::min(limits.rlim_max, most);
    limits.rlim_cur = std::min(limits.rlim_cur, limits.rlim_max);
    setrlimit(what, &limits);
}

} // namespace

void tieToParent() {
    prctl(PR_SET_PDEATHSIG, SIGKILL);
    limit(RLIMIT_CORE, 0);
    limit(RLIMIT_NOFILE, MOST_OPEN_FILES);
}

void limitMemory(std::uint64_t bytes) {
    if (!KEEPS_BOOKS_OF_MEMORY)
        limit(RLIMIT_DATA, bytes + RESERVED_BYTES);
    std::signal(SIGXFSZ, SIG_IGN); // too long a write is an error then
    limit(RLIMIT_FSIZE, bytes);
}

} // namespace quarn
