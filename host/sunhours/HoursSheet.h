#pragma once

#include "engine/images/Image.h"
#include "host/sunhours/SunMoments.h"
#include "host/sunhours/TextPainter.h"

namespace quarn {

/// A sheet to print: title, the coloured map, and below it the legend of its colours; with an arrow
/// to the north where the map is a plan.
Image sheetOf(const Image& map, const SunHoursRequest& request, const SunMoments& moments,
              const TextPainter& text);

/// "21 March 2026, steps of 10 minutes; 11 h 50 min of sun at most", ...: what a person needs to
/// read the numbers right.
std::string subtitleOf(const SunHoursRequest& request, const SunMoments& moments);

/// "21 March 2026", "1 January to 31 December 2026, every 7 days"
std::string daysText(const SunHoursRequest& request);

/// How far a number may be off because the sun moves in steps.
std::string errorText(const SunHoursRequest& request);

} // namespace quarn
