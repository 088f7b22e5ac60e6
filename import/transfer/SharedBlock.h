#pragma once

#include "ground/Result.h"

#include <cstdint>
#include <span>

namespace quarn {

/// Memory that two processes share, as a file without a name: one appends to it, the other reads it
/// when it is whole. Nobody maps it, so that whatever the one does to it meanwhile, the other finds
/// bytes that it has to itself, or an error.
class SharedBlock {
public:
    /// An empty one. No program that is started inherits it.
    /// @return an error, part of a sentence, where the system has none to give
    static Result<SharedBlock> make();
    /// Takes over a descriptor.
    explicit SharedBlock(int descriptor) : m_descriptor(descriptor) {}
    SharedBlock(SharedBlock&& other) noexcept;
    SharedBlock& operator=(SharedBlock&& other) noexcept;
    ~SharedBlock();

    int descriptor() const { return m_descriptor; }

    /// @return an error, part of a sentence, where there is not so much memory to share
    Result<void> append(std::span<const std::uint8_t> bytes);
    /// Fills all of `bytes` with what stands from there on.
    /// @return false when there is not so much
    bool read(std::uint64_t from, std::span<std::uint8_t> bytes) const;
    /// Gives back the memory of the bytes in a range, which are zero from then on; of whole pages.
    void giveBack(std::uint64_t from, std::uint64_t to);

    std::uint64_t size() const;   ///< bytes
    std::uint64_t memory() const; ///< bytes that it takes now

private:
    int m_descriptor = -1;
};

} // namespace quarn
