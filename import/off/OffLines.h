#pragma once

#include "import/off/OffBody.h"

namespace quarn {

/// Tables of the vertices, which several threads fill.
struct OffTables {
    const OffHeader& header;
    std::vector<KM_3dPoint>& places;
    std::vector<KM_2fPoint>& textures;
    std::vector<KM_3fVector>& normals;
    std::vector<std::array<float, 4>>& colors; ///< as the file counts them
};

/// Reads a part's lines: its vertices into the tables, its faces into itself. Stops at the first
/// line that is damaged.
void readOffLines(OffPart& part, const OffTables& tables, char line_break);

} // namespace quarn
