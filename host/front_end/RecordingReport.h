#pragma once

#include "kelmar/KM_wString.h"

#include <filesystem>

namespace quarn {

/// How a recording begins.
struct RecordingStart {
    int wanted = 0; ///< frames that it is to make sure of
    int kept = 0;   ///< those of them that were there already, whole, and stay as they are
};

/// What became of a recording, as it is told once the command that records has ended. It is counted
/// from the files, whatever the command itself says.
struct RecordingReport {
    std::filesystem::path folder;
    std::filesystem::path page; ///< where it is or would be
    int expected = 0;           ///< frames of the animation, or of the part that was asked for
    int written = 0;            ///< pictures that were written
    int kept = 0;               ///< pictures that were there already and stayed as they were
    int elsewhere = 0;          ///< left to other programs that record them now
    int there = 0;              ///< of the written and kept ones, in the folder at the end
    bool is_part = false;       ///< only some frames were asked for, and there is no page of those
    bool has_page = false;      ///< this recording wrote the page, and it is there

    /// Pictures of earlier recordings of this name that are still in the folder; the page does not
    /// show them.
    int left_over = 0;
    KM_wString first_left_over; ///< the name of the first of them; empty where there is none

    bool isComplete() const { return there >= expected; }
};

} // namespace quarn
