#pragma once

#include "kelmar/KM_Point.h"

#include <optional>
#include <span>

class KM_Viewport;

namespace quarn {

/// The place of a line that is seen nearest to a place of the picture.
struct LineHit {
    double distance_px = 0.0;
    double depth = 0.0; ///< from the camera along the view direction, in model units
    KM_3dPoint point;   ///< in world coordinates
};

/// Finds where lines are seen in a picture.
class LinePick {
public:
    /// @param camera      with the picture's size; must be valid
    /// @param x_px, y_px  the place of the picture, from its upper left corner
    LinePick(const KM_Viewport& camera, double x_px, double y_px);

    /// @param polyline  one point stands for itself
    /// @return nothing when all of it lies behind the camera
    std::optional<LineHit> nearest(std::span<const KM_3dPoint> polyline) const;

    /// The height of a pixel in model units at a depth.
    double pixelSizeAt(double depth) const;

private:
    struct Seen {
        double x = 0.0; ///< along the camera's axes, from its location
        double y = 0.0;
        double depth = 0.0;
    };
    Seen see(const KM_3dPoint& point) const;
    bool isBefore(const Seen& seen) const { return !m_is_perspective || seen.depth >= m_nearest; }
    std::optional<LineHit> nearestOf(Seen a, Seen b) const;

    KM_3dPoint m_location;
    KM_3dVector m_x;
    KM_3dVector m_y;
    KM_3dVector m_z;
    bool m_is_perspective;
    double m_nearest;
    double m_left; ///< of the picture; in perspective at depth 1
    double m_top;
    double m_pixel_width;
    double m_pixel_height;
    double m_x_px;
    double m_y_px;
};

} // namespace quarn
