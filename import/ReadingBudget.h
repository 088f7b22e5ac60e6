#pragma once

#include "ground/Result.h"

#include <atomic>
#include <cstdint>
#include <string_view>

namespace quarn {

/// How much memory the content of a model file may take. Readers take their share before they ask
/// for memory, by the counts and sizes that a file states, so that a file which claims much is
/// refused before it harms. Safe to use from several threads.
class ReadingBudget {
public:
    explicit ReadingBudget(std::uint64_t bytes) : m_bytes(bytes) {}

    /// @param what  what the memory is for, in the plural: "textures", "triangles"
    /// @return an error whose message is why not, a part of a sentence, where that much is not
    /// left;
    ///   then nothing was taken
    Result<void> take(std::uint64_t bytes, std::string_view what);
    void giveBack(std::uint64_t bytes) { m_taken -= bytes; }

    std::uint64_t bytes() const { return m_bytes; }

private:
    std::uint64_t m_bytes;
    std::atomic<std::uint64_t> m_taken = 0;
};

} // namespace quarn
