#pragma once

#include "kelmar/KM_wString.h"

#include <filesystem>

namespace quarn {

/// What became of a recording, as it is told once the command that records has ended. It is counted
/// from the files, whatever the command itself says.
struct RecordingReport {
    std::filesystem::path folder;
    std::filesystem::path page; ///< where it is or would be
    int expected = 0;           ///< frames of the animation
    int written = 0;            ///< pictures that were written
    int there = 0;              ///< those of them that are in the folder at the end
    bool has_page = false;      ///< this recording wrote the page, and it is there

    /// Pictures of earlier recordings of this name that are still in the folder; the page does not
    /// show them.
    int left_over = 0;
    KM_wString first_left_over; ///< the name of the first of them; empty where there is none

    bool isComplete() const { return there >= expected; }
};

} // namespace quarn
