#pragma once

#include "engine/images/Image.h"
#include "ground/Result.h"
#include "host/sunhours/SunHoursMap.h"

#include <string>
#include <vector>

namespace quarn {

/// What the page shows.
struct SunHoursPage {
    const SunHoursRequest& request;
    const SunMoments& moments;
    const SunHoursMap& map;
    const Image& picture;                  ///< the coloured map
    const std::vector<std::string>& names; ///< of the scene's mesh objects
    std::filesystem::path page_template;   ///< sunhours.html
};

/// Writes a page that needs nothing beside it: the pointer reads the hours of the place that it is
/// on and, of one day, when the sun reaches it; a slider goes through the day.
Result<void> writeSunHoursPage(const std::filesystem::path& file, const SunHoursPage& page);

} // namespace quarn
