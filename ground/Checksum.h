#pragma once

#include "ground/Result.h"

#include <cstdint>
#include <filesystem>
#include <span>
#include <string>
#include <type_traits>

struct XXH64_state_s; // of the library

namespace quarn {

/// XXH64 of what is added bit by bit (Y. Collet, "xxHash fast digest algorithm", 2023 revision of
/// the format's description, with seed 0): finds damage and change, and keeps nobody out.
class Checksum {
public:
    Checksum();
    ~Checksum();
    Checksum(const Checksum&) = delete;
    Checksum& operator=(const Checksum&) = delete;

    void addBytes(std::span<const std::byte> bytes);
    /// A value without padding, byte by byte.
    template <class Value>
    requires std::is_arithmetic_v<Value> || std::is_enum_v<Value>
    void add(const Value& value) { addBytes(std::as_bytes(std::span(&value, 1))); }
    /// A text and its length, so that two texts that follow each other cannot be taken for others.
    void addText(const std::string& text);

    std::uint64_t value() const;

private:
    XXH64_state_s* m_state;
};

/// How a file is known again.
struct FileChecksum {
    std::uint64_t bytes = 0;
    std::uint64_t xxh64 = 0;
};

/// Reads a whole file, in pieces.
/// @return an error, part of a sentence, where it cannot be read
Result<FileChecksum> checksumOfFile(const std::filesystem::path& file);

/// 16 hexadecimal digits, as other programs print them too.
std::string checksumText(std::uint64_t xxh64);

} // namespace quarn
