#pragma once

#include "ground/Result.h"

#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

enum class PlyFormat { text, little_endian, big_endian };

enum class PlyType : std::uint8_t {
    int8,
    uint8,
    int16,
    uint16,
    int32,
    uint32,
    float32,
    float64,
};

/// In a binary file.
constexpr std::size_t bytesOf(PlyType type) {
    constexpr std::size_t BYTES[] = {1, 1, 2, 2, 4, 4, 4, 8};
    return BYTES[static_cast<std::size_t>(type)];
}

struct PlyProperty {
    std::string name;
    PlyType type = PlyType::float32;
    std::optional<PlyType> count_type; ///< of the number before a list; none when it is no list

    bool isList() const { return count_type.has_value(); }
};

struct PlyElement {
    std::string name;
    std::uint64_t count = 0;
    std::vector<PlyProperty> properties;

    bool hasList() const;
    /// The least bytes that one of these takes. A text may leave out lists.
    std::uint64_t leastBytes(PlyFormat format) const;
};

/// What a PLY file says of its contents in its first lines.
struct PlyHeader {
    PlyFormat format = PlyFormat::text;
    char line_break = '\n';
    std::vector<std::string> comments; ///< without the words that begin them
    std::vector<PlyElement> elements;
    std::size_t bytes = 0; ///< of the header: where the contents begin
};

/// Reads the header of a file.
/// @return an error, a part of a sentence, where it is none or claims more than the file's bytes
///   can be
Result<PlyHeader> readPlyHeader(std::string_view file);

/// "it claims 7 elements of kind 'face' but ends before them"
Error endsBefore(const PlyElement& element);

} // namespace quarn
