#pragma once

#include "ground/Result.h"
#include "import/ply/PlyHeader.h"

#include <cstdint>
#include <string_view>
#include <vector>

namespace quarn {

/// Elements of one kind that follow each other, as many as one thread reads at a time.
struct PlyPart {
    std::size_t kind = 0;    ///< which of the header's elements
    std::uint64_t first = 0; ///< of the elements, from 0
    std::uint64_t count = 0;
    std::string_view bytes; ///< begins with the first one and holds all of them
};

/// Parts the contents of a file. Of a binary file every length is checked against the bytes that
/// are there; of a text that it has a line for each element.
/// @return an error, a part of a sentence, where the file ends too early
Result<std::vector<PlyPart>> partsOfPly(const PlyHeader& header, std::string_view file);

} // namespace quarn
