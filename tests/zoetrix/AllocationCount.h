#pragma once

#include <cstddef>

/// What the program asked operator new for since it started, by all threads.
struct AllocationCount {
    std::size_t small = 0; ///< requests of less than 4096 bytes
    std::size_t large = 0; ///< the others

    static AllocationCount now();
};
