#pragma once

#include <cstdint>

namespace quarn {

/// Ends this process when the one that started it ends, and lets it leave no picture of its memory
/// behind when it crashes.
void tieToParent();

/// Sets how much memory this process and the block that it writes may take: a request far beyond
/// that is refused by the system. Whoever watches the process sees the exact amount.
void limitMemory(std::uint64_t bytes);

} // namespace quarn
