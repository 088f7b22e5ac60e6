#pragma once

#include "host/cities/Cities.h"
#include "host/sun/ClockTime.h"
#include "sdk/qncore/QnCommand.h"

namespace quarn {

/// A place and a moment, as a person gives them for the sun.
struct SunWish {
    SunSite site{};
    const City* city = nullptr; ///< null where the place was given in numbers
    ClockTime clock;
    double north_angle_deg = 0; ///< from the Y axis to north, clockwise seen from above
};

/// Asks for a place (a city or its latitude and longitude), a date and time of day, and then,
/// until Enter or the end of the command's line, for the zone and for north. The zone is the one
/// that follows from the longitude unless another is given. What cannot be is told; a person is
/// then asked again, a script ends.
/// @return success with a whole wish; else the wish is worth nothing
CQuarnCommand::result askPlaceAndTime(SunWish& wish);

} // namespace quarn
