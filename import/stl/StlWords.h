#pragma once

#include "import/assembly/Extent.h"
#include "kelmar/KM_Point.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

/// What a part of a text STL holds.
struct StlPart {
    struct Solid {
        std::string_view name;
        std::size_t first_corner = 0; ///< of the part
    };

    std::vector<Solid> solids;       ///< that begin in this part
    std::vector<KM_3fPoint> corners; ///< three for each triangle
    Extent extent;                   ///< of the corners that are usable numbers
    bool ends_solid = false;         ///< the last word of solids here ends one
    const char* fault = nullptr;     ///< where something is wrong; null: nothing is
    std::string why;                 ///< what; a part of a sentence after its subject
};

/// Parts a text between triangles, for several threads.
std::vector<std::string_view> partsOfStl(std::string_view text);

/// Reads the words of a part.
/// @param origin  what corners are counted from
StlPart readStlPart(std::string_view text, const KM_3dPoint& origin);

} // namespace quarn
