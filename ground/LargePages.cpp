#include "ground/LargePages.h"

#include <cstdint>
#include <sys/mman.h>

namespace quarn {

namespace {

constexpr std::uintptr_t LARGE_PAGE_BYTES = std::uintptr_t{2} << 20;

} // namespace

void askForLargePages(void* memory, std::size_t bytes) {
    const auto address = reinterpret_cast<std::uintptr_t>(memory);
    const std::uintptr_t begin =
        (address + LARGE_PAGE_BYTES - 1) / LARGE_PAGE_BYTES * LARGE_PAGE_BYTES;
    const std::uintptr_t end = (address + bytes) / LARGE_PAGE_BYTES * LARGE_PAGE_BYTES;
    if (begin < end)
        madvise(reinterpret_cast<void*>(begin), end - begin, MADV_HUGEPAGE);
}

} // namespace quarn
