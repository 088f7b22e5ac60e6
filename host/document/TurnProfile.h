#pragma once

#include "kelmar/KM_Viewport.h"

#include <vector>

namespace quarn {

/// The outline of a solid of revolution: what points sweep when they turn about the vertical
/// through a target. Of all points at about one height only the farthest from the vertical counts.
class TurnProfile {
public:
    /// @param low, high  the least and the greatest height (z) of the points
    TurnProfile(const KM_3dPoint& target, double low, double high);

    void add(const KM_3dPoint& point);

    /// The point of the vertical that a camera must look at to see the turning points reach as far
    /// up as down in its picture, when it stands just far enough to see them all. A camera that
    /// looks down on them sees their near side reach farther down than their far side reaches up.
    /// The camera's direction counts, not its location; its elevation is below 90 degrees.
    KM_3dPoint middle(const KM_Viewport& camera) const;

private:
    struct Ring {
        double radius = -1.0; ///< none yet
        double z = 0.0;
    };
    KM_3dPoint m_target;
    double m_low;
    double m_rings_per_height;
    std::vector<Ring> m_rings;
};

} // namespace quarn
