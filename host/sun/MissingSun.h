#pragma once

#include "kelmar/KM_wString.h"

#include <optional>

namespace quarn {

/// A day and a place for which the interface's sun has no position.
struct MissingSun {
    int year;
    int month;
    int day;
    double latitude_deg;
    double longitude_deg;
};

/// Keeps the first sun without a position since the last takeMissingSun, each thread its own: the
/// interface's sun answers "not a number" and knows nobody to tell why.
void noteMissingSun(const MissingSun& missing);

/// Why a sun had no position, a line for the person; nothing when none was noted. Forgets it.
std::optional<KM_wString> takeMissingSun();

} // namespace quarn
