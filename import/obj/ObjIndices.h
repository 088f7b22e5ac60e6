#pragma once

#include "import/obj/ObjPart.h"

#include <vector>

namespace quarn {

/// Makes all indices of the parts of a file count from its beginning, and notes which of them name
/// nothing. Needs the parts' tables.
void resolveIndices(std::vector<ObjPart>& parts, char line_break);

} // namespace quarn
