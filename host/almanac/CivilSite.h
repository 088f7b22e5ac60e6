#pragma once

#include "ground/Result.h"
#include "host/cities/Cities.h"
#include "host/clock/Zone.h"
#include "sdk/qncore/QnExport.h"

#include <string>
#include <string_view>

namespace quarn {

/// Where on the earth a model stands, how it is turned there, and which clocks it goes by.
struct CivilSite {
    std::string place;          ///< "Athens, Greece"; empty where coordinates were typed
    double latitude_deg = 0.0;  ///< north positive, -90 to 90
    double longitude_deg = 0.0; ///< east positive, -180 to 180
    double north_deg = 0.0;     ///< clockwise from the model's Y axis
    Zone zone = Zone::fixed({});
};

/// Gives a site its clocks: those of a name, else those of its city, else of the nearest one.
/// @param written  as Zone::written takes it; empty: none
/// @return the city, where it is only the nearest: a person should know whose clocks they are; an
///         error when there is no such zone
QNCORE_API Result<const City*> giveZone(CivilSite& site, std::string_view written);

/// The longitude as the command of a seasonal study takes it: 0 to 360, eastward.
QNCORE_API double eastwardLongitude(double longitude_deg);

/// "Athens, Greece", or where the place is no city's "37.98 N, 23.73 E".
QNCORE_API std::string placeName(const CivilSite& site);

/// "37.98 N, 105.1786 W"
QNCORE_API std::string coordinatesText(const CivilSite& site);

} // namespace quarn
