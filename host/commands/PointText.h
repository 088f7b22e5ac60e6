#pragma once

#include "ground/Result.h"
#include "kelmar/KM_Point.h"
#include "kelmar/KM_wString.h"

#include <string_view>

namespace quarn {

/// Reads a point written as "x,y,z", whatever the locale; blanks beside the commas are allowed.
/// @return an error that shows the text and how a point is written
Result<KM_3dPoint> readPoint(std::wstring_view text);

/// The text that readPoint reads back as the same point; empty for the unset point.
KM_wString pointText(const KM_3dPoint& point);

} // namespace quarn
