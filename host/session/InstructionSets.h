#pragma once

#include "sdk/qncore/QnExport.h"

#include <optional>
#include <string>
#include <vector>

namespace quarn {

/// The instruction sets that pictures can be drawn with on this processor, the fastest first:
/// "avx512", "avx2", "sse2". Pictures of different sets differ in a few pixels.
QNCORE_API std::vector<std::string> instructionSets();

/// Why SessionOptions::instructions cannot be this name, in a sentence that tells which can;
/// nothing where it can. A session that is started all the same tells it, and draws with the
/// fastest set.
/// @param sets  those that there are
QNCORE_API std::optional<std::string>
whyInstructionsAreRefused(const std::string& name,
                          const std::vector<std::string>& sets = instructionSets());

} // namespace quarn
