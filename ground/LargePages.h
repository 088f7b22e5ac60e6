#pragma once

#include <cstddef>

namespace quarn {

/// Asks the system for large pages (2 MB) under memory that is about to be filled for the first
/// time, which then takes a fraction of the time. Only whole large pages within the memory are
/// asked for, so that nothing more is taken; where the system has none, nothing changes.
void askForLargePages(void* memory, std::size_t bytes);

} // namespace quarn
