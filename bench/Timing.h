#pragma once

#include "ground/Result.h"

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>

/// What the benchmarks share.
namespace bench {

using Clock = std::chrono::steady_clock;

inline double millisecondsSince(Clock::time_point start) {
    return std::chrono::duration<double, std::milli>(Clock::now() - start).count();
}

/// Calls `function` and keeps how long it took when that is less than `best_ms`.
template <class Function> void keepBest(double& best_ms, const Function& function) {
    const auto start = Clock::now();
    function();
    best_ms = std::min(best_ms, millisecondsSince(start));
}

/// Calls `round` until the time is used up, but at least five times and at most forty.
template <class Round> void repeatFor(double budget_ms, const Round& round) {
    constexpr int fewest = 5;
    constexpr int most = 40;
    const auto start = Clock::now();
    for (int i = 0; i < most && (i < fewest || millisecondsSince(start) < budget_ms); ++i)
        round();
}

[[noreturn]] inline void fail(std::string_view why) {
    std::fprintf(stderr, "%.*s\n", static_cast<int>(why.size()), why.data());
    std::exit(1);
}

/// Ends the program with the reason when something that it measures did not work.
inline void require(const quarn::Result<void>& result) {
    if (!result)
        fail(result.message());
}

/// A number of triangles as tables name it: "10 k", "5 M".
inline std::string inWords(int triangles) {
    if (triangles >= 950'000)
        return std::to_string((triangles + 500'000) / 1'000'000) + " M";
    return std::to_string((triangles + 500) / 1000) + " k";
}

} // namespace bench
