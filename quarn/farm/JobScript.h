#pragma once

#include "quarn/farm/FarmRequest.h"

#include <string>
#include <vector>

namespace quarn::program {

/// What stands in a job script.
struct JobScript {
    std::filesystem::path program; ///< quarn itself, absolute
    std::string animation;         ///< its name
    FrameChunks chunks;
};

/// The script in bash that every task of the arrays runs, with the words "frames FIRST", where
/// FIRST is the chunk of the array's task 0, and the last job with the word "finish".
/// @param request  its paths are absolute
std::string jobScriptText(const FarmRequest& request, const JobScript& script);

} // namespace quarn::program
