#pragma once

#include "ground/Result.h"
#include "host/sunpath/Obstruction.h"
#include "kelmar/KM_Point.h"

#include <string>
#include <variant>

class CQuarnDoc;

namespace quarn {

/// Where in a document somebody looks at the sky: at a point of the world, or an object by its name
/// or id (UTF-8). A point object is where it is; others are looked at from the middle of their box,
/// and hide nothing themselves.
using SkyPoint = std::variant<KM_3dPoint, std::string>;

/// What the visible surfaces of a document hide of the sky, but for glass as GlassFilter has it.
/// @param north_deg  clockwise from the Y axis, as seen from above
/// @return an error, a sentence: there is no such object, no visible surface, or no scene can be
///         built
Result<Obstruction> obstructionAround(CQuarnDoc& document, const SkyPoint& place, double north_deg);

} // namespace quarn
