#pragma once

#include "sdk/qncore/QnExport.h"

#include <filesystem>
#include <optional>

namespace quarn {

/// Where on the earth a model stands.
struct StatedSite {
    double latitude_deg = 0.0;    ///< north positive
    double longitude_deg = 0.0;   ///< east positive
    double north_angle_deg = 0.0; ///< from the Y axis to north, clockwise seen from above
};

/// The place that a model file states for itself: IFC files may.
/// @return nothing where it states none, or cannot be read
QNCORE_API std::optional<StatedSite> statedSite(const std::filesystem::path& model);

} // namespace quarn
