#pragma once

#include "engine/sunhours/ObjectPoints.h"
#include "engine/sunhours/SurfaceGrid.h"
#include "ground/AtomicFile.h"
#include "host/sunhours/SunHoursMap.h"

namespace quarn {

/// What an object gets of the sun.
struct ObjectHours {
    std::string name; ///< UTF-8; "object 12" where it has none
    double area = 0.0;
    double mean_hours = 0.0; ///< by area
    double share = 0.0;      ///< of its area that gets at least the threshold
    std::size_t points = 0;  ///< that speak for it
    // The same of the part that looks up, within 45 degrees: a floor or a lawn is a body with sides
    // and an underside.
    double up_area = 0.0;
    double up_mean_hours = 0.0;
    double up_share = 0.0;
};

/// The means over the points of one object.
ObjectHours hoursOf(const ObjectSpan& object, const SurfacePoints& points, const SunLight& light,
                    double threshold_hours);

/// The hours of all pixels as 32-bit floats, rows from the top, not a number where no surface is
/// seen: a NumPy array file, version 1.0 (NumPy, "numpy.lib.format").
Result<void> writeHoursArray(const std::filesystem::path& file, const SunHoursMap& map);

/// One line for each object, with a line of headings: RFC 4180, UTF-8.
/// @param area_unit  "m2"; empty where the model has no units
std::string objectsCsv(const std::vector<ObjectHours>& objects, double threshold_hours,
                       const std::string& area_unit);

/// The triangles of a grid with colours and hours at their corners: PLY 1.0, binary.
/// @param origin  of the grid's coordinates
/// @param end     hours of the scale's last colour
Result<void> writeGrid(const std::filesystem::path& file, const SurfaceGrid& grid,
                       const SunLight& light, const KM_3dPoint& origin, double end);

} // namespace quarn
