#include "host/border/Contract.h"

#include <atomic>
#include <cstdio>
#include <cstdlib>
#include <string>

namespace quarn {

namespace {

/// The interface names no object that these could belong to, and its calls may come when no
/// session runs.
std::atomic<BreachReceiver> receiver = nullptr; // null: as the environment says
std::atomic<std::thread::id> main_thread;       // no thread's id: none was claimed

} // namespace

void logBreach(std::string_view message) {
    std::fprintf(stderr, "Quarn: %.*s\n", static_cast<int>(message.size()), message.data());
}

void abortOnBreach(std::string_view message) {
    logBreach(message);
    std::abort();
}

BreachReceiver breachReceiverOfEnvironment() {
    const char* strict = std::getenv("QUARN_STRICT");
    const bool is_strict = strict && *strict && std::string_view(strict) != "0";
    return is_strict ? abortOnBreach : logBreach;
}

BreachReceiver setBreachReceiver(BreachReceiver new_receiver) {
    const BreachReceiver old = receiver.exchange(new_receiver);
    return old ? old : breachReceiverOfEnvironment();
}

void reportBreach(std::string_view call, std::string_view rule) {
    const BreachReceiver chosen = receiver.load();
    const std::string message = std::string(call) + ": " + std::string(rule);
    (chosen ? chosen : breachReceiverOfEnvironment())(message);
}

void claimMainThread() {
    main_thread.store(std::this_thread::get_id());
}

void releaseMainThread() {
    main_thread.store(std::thread::id());
}

bool isMainThread() {
    const std::thread::id claimed = main_thread.load(std::memory_order_relaxed);
    return claimed == std::this_thread::get_id() || claimed == std::thread::id();
}

bool isOnMainThread(const char* call) {
    if (isMainThread())
        return true;
    reportBreach(call, "only the main thread may call it");
    return false;
}

} // namespace quarn
