#pragma once

#include "host/clock/Zone.h"

#include <chrono>
#include <string>

namespace quarn::program {

/// Where on the earth a model stands, how it is turned there, and which clocks it goes by.
struct StudySite {
    std::string place;          ///< "Athens, Greece"; empty where coordinates were typed
    double latitude_deg = 0.0;  ///< north positive, -90 to 90
    double longitude_deg = 0.0; ///< east positive, -180 to 180
    double north_deg = 0.0;     ///< clockwise from the model's Y axis
    Zone zone = Zone::fixed(std::chrono::minutes(0));
};

/// The longitude as the command of a seasonal study takes it: 0 to 360, eastward.
double eastwardLongitude(double longitude_deg);

/// "Athens, Greece", or where the place is no city's "37.98 N, 23.73 E".
std::string placeName(const StudySite& site);

/// "37.98 N", "105.1786 W"
std::string latitudeText(double latitude_deg);
std::string longitudeText(double longitude_deg);

} // namespace quarn::program
