#include "import/files/LargeStack.h"

#include <cstddef>
#include <pthread.h>

namespace quarn {
namespace {

constexpr std::size_t stack_bytes = std::size_t{512} << 20;

void* runWork(void* work) {
    (*static_cast<const std::function<void()>*>(work))();
    return nullptr;
}

bool runOnThread(const std::function<void()>& work) {
    pthread_attr_t attributes;
    if (pthread_attr_init(&attributes) != 0) {
        return false;
    }
    pthread_t thread{};
    void* const argument = const_cast<std::function<void()>*>(&work); // handed back as constant
    const bool started = pthread_attr_setstacksize(&attributes, stack_bytes) == 0 &&
                         pthread_create(&thread, &attributes, runWork, argument) == 0;
    pthread_attr_destroy(&attributes);
    return started && pthread_join(thread, nullptr) == 0;
}

} // namespace

void runWithLargeStack(const std::function<void()>& work) {
    if (!runOnThread(work)) {
        work();
    }
}

} // namespace quarn
