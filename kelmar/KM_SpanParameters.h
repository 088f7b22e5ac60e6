#pragma once

#include "kelmar/KM_Interval.h"

#include <vector>

namespace kelmar {

/// Maps ascending parameters linearly from one interval to another; values equal to an end of
/// `from` become the end of `to` exactly.
/// @return false, with the parameters unchanged, unless both intervals increase and the mapped
///         parameters are finite and still tell apart what differed
bool stretchParameters(std::vector<double>& parameters, const KM_Interval& from,
                       const KM_Interval& to);

/// Negates the parameters and turns their order round, so that they ascend again.
void reverseParameters(std::vector<double>& parameters);

} // namespace kelmar
