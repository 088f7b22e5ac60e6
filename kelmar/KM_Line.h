#pragma once

#include "kelmar/KM_Export.h"
#include "kelmar/KM_Point.h"

/// A straight piece from one point to another.
class KELMAR_API KM_Line {
public:
    KM_3dPoint from;
    KM_3dPoint to;

    constexpr KM_Line() = default;
    constexpr KM_Line(const KM_3dPoint& from_, const KM_3dPoint& to_) : from(from_), to(to_) {}

    /// True when both ends are valid; they may coincide.
    bool IsValid() const { return from.IsValid() && to.IsValid(); }
    /// The point at the fraction `t`: 0 gives `from` and 1 gives `to`, both exactly; other values
    /// extend the line.
    KM_3dPoint PointAt(double t) const;
    /// Length in model units.
    double Length() const { return from.DistanceTo(to); }
    /// to - from
    KM_3dVector Direction() const { return to - from; }
};
