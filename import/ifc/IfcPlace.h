#pragma once

#include "import/ImportedModel.h"

#include <cstdint>
#include <optional>
#include <span>

namespace quarn {

/// The place that an IFC file states for its site (IfcSite.RefLatitude and RefLongitude, ISO 16739,
/// 5.4.3.52), with the direction of true north in its coordinates
/// (IfcGeometricRepresentationContext.TrueNorth, 8.15.3.2). The library that reads these files
/// keeps both to itself. Rounded to a millionth of a degree.
/// @param bytes  of the file
/// @return nothing where the first site states no place, or no valid one
std::optional<ImportedPlace> placeOfIfc(std::span<const std::uint8_t> bytes);

} // namespace quarn
