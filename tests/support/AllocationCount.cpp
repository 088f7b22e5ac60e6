#include "tests/support/AllocationCount.h"

#include <atomic>

namespace {

constexpr std::size_t large_bytes = 4096;

std::atomic<std::size_t> small_count{0};
std::atomic<std::size_t> large_count{0};

void count(std::size_t bytes) {
    (bytes < large_bytes ? small_count : large_count).fetch_add(1, std::memory_order_relaxed);
}

} // namespace

#if defined(__has_feature)
#define HAS_FEATURE(name) __has_feature(name)
#else
#define HAS_FEATURE(name) 0
#endif

#if defined(__SANITIZE_ADDRESS__) || HAS_FEATURE(address_sanitizer)

// The sanitizer's heap has hooks of its own; not every compiler brings the header that names them.

extern "C" {
int __sanitizer_install_malloc_and_free_hooks(void (*allocated)(const volatile void*, std::size_t),
                                              void (*freed)(const volatile void*));
std::size_t __sanitizer_get_current_allocated_bytes();
}

namespace {

const int hooks = __sanitizer_install_malloc_and_free_hooks(
    [](const volatile void*, std::size_t bytes) { count(bytes); }, [](const volatile void*) {});

} // namespace

AllocationCount AllocationCount::now() {
    static_cast<void>(hooks);
    return {small_count.load(), large_count.load(), __sanitizer_get_current_allocated_bytes()};
}

#else

#include <cerrno>
#include <malloc.h>

// These take the place of the C library's in the whole program, its libraries too; the standard
// library's operator new asks them. What they stand for is reached by the C library's other names.

extern "C" {
void* __libc_malloc(std::size_t bytes);
void* __libc_calloc(std::size_t count, std::size_t bytes);
void* __libc_realloc(void* memory, std::size_t bytes);
void* __libc_memalign(std::size_t alignment, std::size_t bytes);
void __libc_free(void* memory);
}

namespace {

std::atomic<std::size_t> held{0};

void* counted(void* memory, std::size_t bytes) {
    if (!memory)
        return nullptr;
    count(bytes);
    held.fetch_add(malloc_usable_size(memory), std::memory_order_relaxed);
    return memory;
}

} // namespace

AllocationCount AllocationCount::now() {
    return {small_count.load(), large_count.load(), held.load()};
}

extern "C" {

void* malloc(std::size_t bytes) {
    return counted(__libc_malloc(bytes), bytes);
}

void* calloc(std::size_t count, std::size_t bytes) {
    return counted(__libc_calloc(count, bytes), count * bytes);
}

void* realloc(void* memory, std::size_t bytes) {
    const std::size_t before = memory ? malloc_usable_size(memory) : 0;
    void* const moved = __libc_realloc(memory, bytes);
    if (moved || bytes == 0)
        held.fetch_sub(before, std::memory_order_relaxed);
    return counted(moved, bytes);
}

void* memalign(std::size_t alignment, std::size_t bytes) {
    return counted(__libc_memalign(alignment, bytes), bytes);
}

void* aligned_alloc(std::size_t alignment, std::size_t bytes) {
    return counted(__libc_memalign(alignment, bytes), bytes);
}

int posix_memalign(void** memory, std::size_t alignment, std::size_t bytes) {
    *memory = counted(__libc_memalign(alignment, bytes), bytes);
    return *memory ? 0 : ENOMEM;
}

void free(void* memory) {
    if (memory)
        held.fetch_sub(malloc_usable_size(memory), std::memory_order_relaxed);
    __libc_free(memory);
}

} // extern "C"

#endif
