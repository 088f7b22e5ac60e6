#include "import/ReadingBudget.h"

#include "ground/FreeMemory.h"

#include <string>

namespace quarn {

Result<void> ReadingBudget::take(std::uint64_t bytes, std::string_view what) {
    std::uint64_t taken = m_taken;
    do {
        if (bytes > m_bytes - taken)
            return Error{"its " + std::string(what) + " need " + gigabyteText(bytes) +
                         " of memory, and of the " + gigabyteText(m_bytes) +
                         " that reading may take (--limit-memory) only " +
                         gigabyteText(m_bytes - taken) + " are left"};
    } while (!m_taken.compare_exchange_weak(taken, taken + bytes));
    return {};
}

} // namespace quarn
