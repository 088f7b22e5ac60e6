#include "kelmar/KM_SpanParameters.h"

#include <algorithm>
#include <cmath>

namespace kelmar {

bool stretchParameters(std::vector<double>& parameters, const KM_Interval& from,
                       const KM_Interval& to) {
    if (!from.IsIncreasing() || !to.IsIncreasing())
        return false;
    std::vector<double> stretched;
    stretched.reserve(parameters.size());
    for (const double parameter : parameters)
        stretched.push_back(std::lerp(to.m_t[0], to.m_t[1], from.NormalizedParameterAt(parameter)));
    for (std::size_t i = 0; i < stretched.size(); ++i) {
        if (!KM_IsValid(stretched[i]))
            return false;
        if (i > 0 && parameters[i - 1] < parameters[i] && !(stretched[i - 1] < stretched[i]))
            return false;
    }
    parameters = std::move(stretched);
    return true;
}

void reverseParameters(std::vector<double>& parameters) {
    std::reverse(parameters.begin(), parameters.end());
    // Subtracted from 0, so that 0 does not become -0.
    for (double& parameter : parameters)
        parameter = 0.0 - parameter;
}

} // namespace kelmar
