#pragma once

#include "kelmar/KM_Color.h"

namespace quarn {

/// Of lines and letters on a sheet.
inline constexpr KM_Color SHEET_INK{24, 26, 30, 255};

/// The colour of a number from 0 to 1 in the perceptually even scale "viridis" (S. van der Walt and
/// N. Smith, 2015, released under CC0): eleven of its colours, with straight lines between them.
KM_Color viridis(double share);

/// What a scale of hours ends with: whole hours that hold all of them, at least 1.
double endOfScale(double hours);

} // namespace quarn
