#pragma once

#include "host/border/Contract.h"

#include <gtest/gtest.h>

#include <mutex>
#include <string>
#include <utility>
#include <vector>

namespace quarn::test {

/// While one lives, breaches of the interface are kept in a list; elsewhere they end a test
/// program. One at a time. What is left in the list at the end fails the test.
class BreachList {
public:
    BreachList() : m_former(setBreachReceiver(keep)) {}
    ~BreachList() {
        setBreachReceiver(m_former);
        EXPECT_EQ(take(), std::vector<std::string>());
    }
    BreachList(const BreachList&) = delete;
    BreachList& operator=(const BreachList&) = delete;

    /// The breaches since the last call.
    std::vector<std::string> take() {
        const std::lock_guard lock(mutex);
        return std::exchange(kept, {});
    }

private:
    static void keep(std::string_view message) {
        const std::lock_guard lock(mutex);
        kept.emplace_back(message);
    }

    static inline std::mutex mutex;
    static inline std::vector<std::string> kept;
    BreachReceiver m_former;
};

} // namespace quarn::test
