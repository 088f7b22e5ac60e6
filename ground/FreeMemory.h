#pragma once

#include <cstdint>

namespace quarn {

/// Bytes of memory that the program can still use without others being swapped out; the largest
/// number where the system does not tell.
std::uint64_t freeMemory();

} // namespace quarn
