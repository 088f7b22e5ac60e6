#pragma once

#include "host/sunpath/Drawing.h"

namespace quarn {

/// A drawing as a file of Scalable Vector Graphics 1.1, without scripts, style sheets or fonts of
/// its own, so that every drawing program reads it. Texts may be any bytes: what is no UTF-8, and
/// control characters, stand as a question mark.
std::string svgText(const Drawing& drawing);

} // namespace quarn
