#pragma once

#include "engine/images/Image.h"
#include "host/letters/SheetWords.h"
#include "host/sunhours/SunMoments.h"
#include "host/sunhours/TextPainter.h"

namespace quarn {

/// "11 h"
inline constexpr SheetText WHOLE_HOURS{L"%1 h", 42989};

/// A sheet to print: title, the coloured map, and below it the legend of its colours; with an arrow
/// to the north where the map is a plan.
Image sheetOf(const Image& map, const SunHoursRequest& request, const SunMoments& moments,
              const TextPainter& text);

/// "Hours of sun · pavilion"
std::string titleOf(const SunHoursRequest& request, const SheetWords& words);

/// "Athens, Greece · 21 Mar 2026 (EET) · at most 12 h of sun": what a person needs to read the
/// numbers right.
std::string subtitleOf(const SunHoursRequest& request, const SunMoments& moments,
                       const SheetWords& words);

/// What the colours tell, and how far a number may be off because the sun moves in steps.
std::string legendOf(const SunHoursRequest& request, const SunMoments& moments,
                     const SheetWords& words);

/// "11 h 50 min"
std::string hoursText(double hours, const SheetWords& words);

} // namespace quarn
