#pragma once

#include "host/clock/Zone.h"
#include "host/sun/SunEvents.h"
#include "quarn/reports/SunReport.h"

#include <chrono>
#include <string>
#include <vector>

namespace quarn::program {

/// The sun at an instant.
struct TimedSun {
    std::chrono::sys_seconds time;
    SunPosition position;
};

/// The sun through a day of the place's calendar.
struct SunDay {
    std::chrono::local_days date;
    SunEvents sun;
};

/// All that is told.
struct SunTelling {
    std::vector<SunDay> days; ///< those of the positions, in their order
    std::vector<TimedSun> positions;
};

/// "rise", "transit", "set"
const char* nameOf(SunEvent::Kind kind);
/// "polar day", "polar night"; empty where the sun rises or sets.
const char* nameOf(SunEvents::Course course);
/// With so many digits behind the point.
std::string fixedText(double value, int digits);

/// The same in each form.
std::string textOf(const SunRequest& request, const SunTelling& telling);
std::string csvOf(const SunRequest& request, const SunTelling& telling);
std::string jsonOf(const SunRequest& request, const SunTelling& telling);

} // namespace quarn::program
