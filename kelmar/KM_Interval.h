#pragma once

#include "kelmar/KM_Export.h"
#include "kelmar/KM_Point.h"

/// A range of parameters from m_t[0] to m_t[1], which may run downward.
class KELMAR_API KM_Interval {
public:
    double m_t[2] = {KM_UNSET_VALUE, KM_UNSET_VALUE};

    /// An interval without ends: not valid.
    constexpr KM_Interval() = default;
    constexpr KM_Interval(double t0, double t1) : m_t{t0, t1} {}

    /// True when both ends are finite and set.
    bool IsValid() const { return KM_IsValid(m_t[0]) && KM_IsValid(m_t[1]); }
    /// The smaller and the larger end; KM_UNSET_VALUE when the interval is not valid.
    double Min() const;
    double Max() const;
    /// m_t[1] - m_t[0], negative for an interval that runs downward; 0 when it is not valid.
    double Length() const;
    /// The parameter at the fraction `s`: 0 gives m_t[0] and 1 gives m_t[1], both exactly.
    double ParameterAt(double s) const { return (1.0 - s) * m_t[0] + s * m_t[1]; }
    /// The fraction at the parameter `t`; m_t[0] gives 0 and m_t[1] gives 1, both exactly. 0 for
    /// an interval without length.
    double NormalizedParameterAt(double t) const;
    /// True when the interval is valid and m_t[0] < m_t[1].
    bool IsIncreasing() const { return IsValid() && m_t[0] < m_t[1]; }
    /// True when Min() <= t <= Max() and the interval is valid.
    bool Includes(double t) const;

    friend bool operator==(const KM_Interval& a, const KM_Interval& b) {
        return a.m_t[0] == b.m_t[0] && a.m_t[1] == b.m_t[1];
    }
};
