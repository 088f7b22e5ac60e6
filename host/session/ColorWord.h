#pragma once

#include "sdk/qncore/QnExport.h"

#include <optional>
#include <string>

namespace quarn {

/// Reads a colour as RenderSettings does: "#ff8800", "FF8800", "white".
/// @return "#ff8800"; nothing for what is no colour
QNCORE_API std::optional<std::string> colorWord(const std::string& word);

} // namespace quarn
