#pragma once

#include "kelmar/KM_Point.h"

#include <filesystem>
#include <optional>
#include <string>

namespace quarn {

/// A model file whose coordinates count from a place near the model.
struct ShiftedFile {
    KM_3dPoint origin; ///< the place, in the file's coordinates
    std::string bytes; ///< the file with that much less in each coordinate
};

/// The library that reads models keeps coordinates in single precision, which would round those of
/// a surveyed site, millions of metres from the origin, to half a metre. OBJ files state them as
/// text with all their digits: there they can be brought near before they are read.
/// @return nothing unless the file is an OBJ file whose first vertex has a coordinate of 10,000 or
///   more and whose vertices can all be understood
std::optional<ShiftedFile> shiftFarCoordinates(const std::filesystem::path& path);

} // namespace quarn
