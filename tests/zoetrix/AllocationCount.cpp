#include "tests/zoetrix/AllocationCount.h"

#include <atomic>
#include <cstdlib>
#include <new>

namespace {

constexpr std::size_t large_bytes = 4096;

std::atomic<std::size_t> small_count{0};
std::atomic<std::size_t> large_count{0};

void* counted(std::size_t bytes, std::size_t alignment) {
    (bytes < large_bytes ? small_count : large_count).fetch_add(1, std::memory_order_relaxed);
    const std::size_t whole = (bytes + alignment - 1) / alignment * alignment;
    void* const memory = alignment > alignof(std::max_align_t)
                             ? std::aligned_alloc(alignment, whole)
                             : std::malloc(bytes > 0 ? bytes : 1);
    if (!memory)
        throw std::bad_alloc();
    return memory;
}

} // namespace

AllocationCount AllocationCount::now() {
    return {small_count.load(), large_count.load()};
}

// These take the place of the standard library's in the whole program, its libraries too.

void* operator new(std::size_t bytes) {
    return counted(bytes, 1);
}
void* operator new[](std::size_t bytes) {
    return counted(bytes, 1);
}
void* operator new(std::size_t bytes, std::align_val_t alignment) {
    return counted(bytes, static_cast<std::size_t>(alignment));
}
void* operator new[](std::size_t bytes, std::align_val_t alignment) {
    return counted(bytes, static_cast<std::size_t>(alignment));
}
void operator delete(void* memory) noexcept {
    std::free(memory);
}
void operator delete[](void* memory) noexcept {
    std::free(memory);
}
void operator delete(void* memory, std::size_t) noexcept {
    std::free(memory);
}
void operator delete[](void* memory, std::size_t) noexcept {
    std::free(memory);
}
void operator delete(void* memory, std::align_val_t) noexcept {
    std::free(memory);
}
void operator delete[](void* memory, std::align_val_t) noexcept {
    std::free(memory);
}
void operator delete(void* memory, std::size_t, std::align_val_t) noexcept {
    std::free(memory);
}
void operator delete[](void* memory, std::size_t, std::align_val_t) noexcept {
    std::free(memory);
}
