#pragma once

#include "engine/sunhours/SunStep.h"
#include "host/sunhours/SunHoursRequest.h"

#include <vector>

namespace quarn {

/// A moment at which the sun stands above the horizon.
struct SunMoment {
    std::chrono::sys_seconds time;
    SunStep step; ///< in the model's coordinates; hours are those of a day, on average
};

/// The moments of the days that are asked for, in their order: at each step from `from` on, and at
/// `to`. A moment stands for the halves of the spans on its two sides, so that together they last
/// from `from` to `to`; an hour that clocks skip is not there, one that they show twice is there
/// twice. Ends that are told from sunrise or sunset are each day's own, and midnight on days
/// without.
struct SunMoments {
    std::vector<SunMoment> moments;
    int days = 0;
    double hours = 0.0; ///< of a day on average with the sun above the horizon

    /// Whether a page shows each of them: those of one day, and not too many to carry.
    bool areShown() const { return days == 1 && moments.size() <= most_shown; }
    static constexpr std::size_t most_shown = 300;
};

SunMoments momentsOf(const SunHoursRequest& request);

} // namespace quarn
