#pragma once

#include "sdk/qncore/QnExport.h"

#include <string>
#include <vector>

namespace quarn {

/// The instruction sets that pictures can be drawn with on this processor, the fastest first:
/// "avx512", "avx2", "sse2". Pictures of different sets differ in their last bits.
QNCORE_API std::vector<std::string> instructionSets();

} // namespace quarn
