#pragma once

#include "kelmar/KM_wString.h"

#include <cmath>
#include <cstdlib>

/// The time zone in which sun studies reckon: the whole hours of a longitude, counted from
/// Greenwich toward it. No border and no daylight saving enters, so the clocks on a wall there may
/// show another one.
///
/// @param longitude  degrees, east positive, -360 to 360
/// @return hours ahead of universal time, -24 to 24; 0 for a longitude outside, or that is no
/// number
inline int QnZoneOfLongitude(double longitude) {
    if (!(std::fabs(longitude) <= 360.0))
        return 0;
    return static_cast<int>(longitude * 24.0 / 360.0);
}

/// A time zone as a person reads it: "UTC", "UTC+1", "UTC-3:30".
///
/// @param minutes  ahead of universal time
inline KM_wString QnZoneText(int minutes) {
    if (minutes == 0)
        return L"UTC";
    const int size = std::abs(minutes);
    const KM_wString hours =
        KM_wString::FormatToString(L"UTC%c%d", minutes < 0 ? L'-' : L'+', size / 60);
    return size % 60 == 0 ? hours : hours + KM_wString::FormatToString(L":%02d", size % 60);
}
