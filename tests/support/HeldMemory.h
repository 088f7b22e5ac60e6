#pragma once

#include <cstddef>

#if defined(__SANITIZE_ADDRESS__)
// Of the sanitizers' runtime; g++ brings the function and not the header.
extern "C" std::size_t __sanitizer_get_current_allocated_bytes();
#else
#include <malloc.h>
#endif

namespace quarn::test {

/// Bytes of the heap that the whole program holds now. Allocators keep some kilobytes of what was
/// given back, so two answers are the same but for these.
inline std::size_t heldMemory() {
#if defined(__SANITIZE_ADDRESS__)
    return __sanitizer_get_current_allocated_bytes();
#else
    const struct mallinfo2 heap = mallinfo2();
    return heap.uordblks + heap.hblkhd;
#endif
}

} // namespace quarn::test
