#pragma once

#include "kelmar/KM_wString.h"

namespace quarn {

/// What a person calls the place of the sun study, and the clocks there: the animation record knows
/// coordinates alone. It counts as long as the record has these coordinates.
struct StudiedPlace {
    KM_wString city; ///< "Berlin, Germany"; empty: the place has no name
    KM_wString zone; ///< as Zone::written takes it
    double latitude_deg = 0.0;
    double longitude_deg = 0.0; ///< as the record has it, -180 to 360

    /// Whether it is the place of a record with these coordinates.
    bool isAt(double latitude, double longitude) const {
        return latitude_deg == latitude && longitude_deg == longitude;
    }

    friend bool operator==(const StudiedPlace&, const StudiedPlace&) = default;
};

} // namespace quarn
