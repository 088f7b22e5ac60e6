#pragma once

#include "host/session/SunHours.h"
#include "quarn/scripts/StudyView.h"
#include "quarn/session/HostSession.h"
#include "quarn/words/Outcome.h"

#include <string>
#include <vector>

namespace quarn::program {

/// Of which model hours of sun are asked for.
struct SunHoursWish {
    std::filesystem::path model;
    std::string up_axis; ///< as readingLine has it
    StudyView view;      ///< of no account to a plan
    SunHoursRequest hours;
    std::vector<std::string> notes{}; ///< of the times: sentences without their full stops
    CommonOptions common;
};

/// `quarn sunhours`: reads the model and has the host find and write them.
Outcome writeSunHours(const SunHoursWish& wish);

} // namespace quarn::program
