#pragma once

#include "kelmar/KM_wString.h"

#include <filesystem>

namespace quarn {

/// What became of a file that is made for others to see.
struct SharedFileReport {
    std::filesystem::path file;
    bool is_made = false;
    /// In the user's language, without a line break: what the file holds, or a sentence that says
    /// why there is none and what to do.
    KM_wString text;
    std::filesystem::path picture = {}; ///< that can be looked at beside it; empty: none
};

} // namespace quarn
