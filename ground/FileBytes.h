#pragma once

#include "ground/Result.h"

#include <cstdint>
#include <filesystem>
#include <limits>
#include <memory>
#include <span>
#include <utility>

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

/// The bytes of a file where the system keeps them, without a copy. Who shortens the file meanwhile
/// ends the program that reads on (SIGBUS): for processes that may end.
class MappedFile {
public:
    /// Takes over a mapping.
    MappedFile(const std::uint8_t* bytes, std::size_t size) : m_bytes(bytes), m_size(size) {}
    MappedFile(MappedFile&& other) noexcept
        : m_bytes(std::exchange(other.m_bytes, nullptr)), m_size(std::exchange(other.m_size, 0)) {}
    MappedFile& operator=(MappedFile&& other) noexcept {
        std::swap(m_bytes, other.m_bytes);
        std::swap(m_size, other.m_size);
        return *this;
    }
    ~MappedFile();

    /// Valid as long as this object.
    std::span<const std::uint8_t> bytes() const { return {m_bytes, m_size}; }

private:
    const std::uint8_t* m_bytes;
    std::size_t m_size;
};

/// Maps a whole file.
/// @return an error as readFileBytes has it
Result<MappedFile> mapFile(const std::filesystem::path& file);

/// Reads a whole file.
/// @param most_bytes  a longer file is not read
/// @return an error, part of a sentence: it is missing, no ordinary file, not readable, too long,
///         or too large for the memory
Result<FileBytes> readFileBytes(const std::filesystem::path& file,
                                std::size_t most_bytes = std::numeric_limits<std::size_t>::max());

} // namespace quarn
