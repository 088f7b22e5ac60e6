#pragma once

#include "host/sunpath/Drawing.h"

namespace quarn {

/// The areas that a stroke along lines covers, to be filled by the rule of the winding number.
/// Corners are pointed, sharp ones cut; ends are cut straight.
/// @param is_closed  the last point of each line is joined with its first
std::vector<std::vector<DrawnPoint>> strokeAreas(const std::vector<std::vector<DrawnPoint>>& lines,
                                                 bool is_closed, const DrawnStroke& stroke);

} // namespace quarn
