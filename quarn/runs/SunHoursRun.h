#pragma once

#include "host/session/SunHours.h"
#include "quarn/scripts/StudyView.h"
#include "quarn/session/HostSession.h"
#include "quarn/words/Outcome.h"

namespace quarn::program {

/// Of which model hours of sun are asked for.
struct SunHoursWish {
    std::filesystem::path model;
    std::string up_axis; ///< as readingLine has it
    StudyView view;      ///< of no account to a plan
    SunHoursRequest hours;
    std::string zone_note; ///< how the clock was chosen, where nobody named it; a sentence
    CommonOptions common;
};

/// `quarn sunhours`: reads the model and has the host find and write them.
Outcome writeSunHours(const SunHoursWish& wish);

} // namespace quarn::program
