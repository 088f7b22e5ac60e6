#include "kelmar/KM_Interval.h"

#include <algorithm>

double KM_Interval::Min() const {
    return IsValid() ? std::min(m_t[0], m_t[1]) : KM_UNSET_VALUE;
}

double KM_Interval::Max() const {
    return IsValid() ? std::max(m_t[0], m_t[1]) : KM_UNSET_VALUE;
}

double KM_Interval::Length() const {
    return IsValid() ? m_t[1] - m_t[0] : 0.0;
}

double KM_Interval::NormalizedParameterAt(double t) const {
    const double length = Length();
    return length == 0.0 ? 0.0 : (t - m_t[0]) / length;
}

bool KM_Interval::Includes(double t) const {
    return IsValid() && Min() <= t && t <= Max();
}
