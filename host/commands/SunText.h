#pragma once

#include "kelmar/KM_wString.h"

namespace quarn {

class DocumentSun;

/// One line on the sun of a document: "sun: on, azimuth 135, altitude 45", in degrees clockwise
/// from the Y axis and above the horizon, to 0.01 degrees.
KM_wString sunText(const DocumentSun& sun);

/// An angle to 0.01 degrees, with as few digits as that takes.
KM_wString angleText(double degrees);

/// As angleText, of a direction all around: from 0 up to but not including 360.
KM_wString azimuthText(double degrees);

} // namespace quarn
