#pragma once

#include "quarn/words/Words.h"

#include <optional>
#include <string>

namespace quarn::program {

/// The host command that lets the camera look at a point from a direction; FitView, which comes
/// after it, keeps that direction and finds the distance.
///
/// @param azimuth_deg    of the camera about the target, counter-clockwise from the X axis
/// @param elevation_deg  of the camera above the horizon through the target, -89 to 89
/// @param lens_mm        makes the view a perspective one with this lens; nothing: as it is
std::string cameraToBeFitted(const Triple& target, double azimuth_deg, double elevation_deg,
                             const std::optional<double>& lens_mm = {});

/// The options of the host command Camera that make the view a perspective one with this lens.
std::string lensAnswer(double lens_mm);

} // namespace quarn::program
