#pragma once

#include <cstdint>
#include <string>

namespace quarn {

/// Bytes of memory that the program can still use without others being swapped out; the largest
/// number where the system does not tell.
std::uint64_t freeMemory();

/// An amount of memory as a person reads it: "4.5 GB".
std::string gigabyteText(std::uint64_t bytes);

} // namespace quarn
