#pragma once

#include "ground/Result.h"

#include <cstdint>
#include <filesystem>
#include <limits>
#include <memory>
#include <span>

namespace quarn {

/// The bytes of a file, read at once. They are not set before they are read, which would take as
/// long as reading them.
class FileBytes {
public:
    FileBytes(std::unique_ptr<std::uint8_t[]> bytes, std::size_t size)
        : m_bytes(std::move(bytes)), m_size(size) {}

    std::span<const std::uint8_t> bytes() const { return {m_bytes.get(), m_size}; }

private:
    std::unique_ptr<std::uint8_t[]> m_bytes;
    std::size_t m_size;
};

/// Reads a whole file.
/// @param most_bytes  a longer file is not read
/// @return an error, part of a sentence: it is missing, no ordinary file, not readable, too long,
///         or too large for the memory
Result<FileBytes> readFileBytes(const std::filesystem::path& file,
                                std::size_t most_bytes = std::numeric_limits<std::size_t>::max());

} // namespace quarn
