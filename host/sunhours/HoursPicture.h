#pragma once

#include "engine/images/Image.h"
#include "host/sunhours/SunHoursMap.h"

namespace quarn {

/// The map in colours, as large as it is, on white. Borders, where another object or another face
/// begins, are drawn as fine lines, and what they cross is looked at four times more, so that they
/// are smooth.
/// @return nothing where `watch` ended the work
std::optional<Image> colouredMap(const DisplayScene& scene, const KM_Viewport& viewport,
                                 const SunHoursRequest& request, const SunMoments& moments,
                                 const SunHoursMap& map, const SunWatch& watch);

} // namespace quarn
