#pragma once

#include <cstddef>

/// What the program asked the heap for since it started: all its threads and all its libraries, in
/// C and in C++. Stays as it is where nothing asked.
struct AllocationCount {
    std::size_t small = 0;      ///< requests of less than 4096 bytes
    std::size_t large = 0;      ///< the others
    std::size_t held_bytes = 0; ///< what was asked for and not given back yet

    std::size_t all() const { return small + large; }

    static AllocationCount now();
};

/// What was asked for between two counts.
inline std::size_t requestsBetween(const AllocationCount& before, const AllocationCount& after) {
    return after.all() - before.all();
}
