#pragma once

#include "kelmar/KM_3dPointArray.h"

#include <span>
#include <utility>
#include <vector>

namespace quarn {

/// A piece of a line between two points.
using LineSegment = std::pair<KM_3dPoint, KM_3dPoint>;

/// Joins segments whose ends have exactly the same place into polylines. First each run of
/// segments that follow each other in the file, tail to head, becomes one; then runs are joined
/// where the ends of exactly two meet, so that a branching stays a place where polylines end. A
/// run keeps its direction where it can: the earlier one decides. Segments of no length are left
/// out.
///
/// @return polylines of at least two points, in the order of their first segments; the last point
///   of a closed one equals its first
std::vector<KM_3dPointArray> joinSegments(std::span<const LineSegment> segments);

} // namespace quarn
