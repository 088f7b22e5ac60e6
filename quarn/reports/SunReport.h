#pragma once

#include "host/almanac/CivilSite.h"
#include "quarn/words/Outcome.h"

#include <chrono>
#include <vector>

namespace quarn::program {

/// What a person wants to know of the sun.
struct SunRequest {
    enum class Form { text, csv, json };
    CivilSite site;
    std::chrono::sys_seconds from; ///< of the first position
    std::chrono::sys_seconds to;   ///< no position is later; not before `from`
    std::chrono::minutes step{60};
    Form form = Form::text;
    std::vector<std::string> notes; ///< sentences without their full stops
};

/// `quarn sun`: tells the positions of the sun, and its rises, transits and sets on the days of the
/// place's calendar that they lie in.
Outcome reportSun(const SunRequest& request);

} // namespace quarn::program
