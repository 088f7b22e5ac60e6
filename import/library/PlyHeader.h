#pragma once

#include <cstdint>
#include <istream>
#include <optional>
#include <string>
#include <vector>

namespace quarn {

struct PlyProperty {
    std::string name;
    int count_bytes = 0; ///< of the number before a list, 0 when it is no list
    int value_bytes = 0;
};

struct PlyElement {
    std::string name;
    std::uint64_t count = 0;
    std::vector<PlyProperty> properties;

    bool hasList() const;
    /// The least bytes that one of these takes, as text or as binary. Text may leave out lists.
    std::uint64_t leastBytes(bool text) const;
};

/// What a PLY file says of its contents in its first lines.
struct PlyHeader {
    bool text = false;
    bool big_endian = false;
    std::vector<PlyElement> elements;
};

/// Reads the header up to and with its last line.
/// @param file  behind its first line
/// @return nothing where the header is damaged
std::optional<PlyHeader> readPlyHeader(std::istream& file);

} // namespace quarn
