#pragma once

#include "host/clock/Zone.h"

#include <string>

namespace quarn::program {

/// Where on the earth a person asks about the sun, and the clock on the wall there.
struct CivilSite {
    std::string place;          ///< "Athens, Greece"; empty where coordinates were typed
    double latitude_deg = 0.0;  ///< north positive, -90 to 90
    double longitude_deg = 0.0; ///< east positive, -180 to 180
    Zone zone = Zone::fixed({});
    std::string zone_origin; ///< whose zone it is, where nobody named one: "Potsdam, Germany"
};

} // namespace quarn::program
