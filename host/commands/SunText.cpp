#include "host/commands/SunText.h"

#include "host/document/DocumentSun.h"
#include "host/prompt/NumberText.h"
#include "host/sun/SunDirection.h"

#include <cmath>

namespace quarn {

KM_wString angleText(double degrees) {
    return numberText(std::round(degrees * 100) / 100 + 0.0); // no "-0"
}

KM_wString azimuthText(double degrees) {
    const double turned = std::fmod(std::fmod(degrees, 360) + 360, 360);
    return angleText(turned < 359.995 ? turned : 0);
}

KM_wString sunText(const DocumentSun& sun) {
    const SunPosition position = positionOfSun(sun.directionToSun());
    return KM_wString(L"sun: ") + (sun.isEnabled() ? L"on" : L"off") + L", azimuth " +
           azimuthText(position.azimuth_deg) + L", altitude " + angleText(position.altitude_deg) +
           L"\n";
}

} // namespace quarn
