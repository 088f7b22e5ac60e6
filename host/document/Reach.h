#pragma once

#include "kelmar/KM_Viewport.h"

#include <algorithm>
#include <cmath>

namespace quarn {

/// How far out the farthest point comes, from the middle of the picture (0) to its border (1).
inline constexpr double FILL = 0.95;

/// Half the opening of the picture that may be filled: width and height, as tangents of the half
/// angles in perspective.
struct Opening {
    double x;
    double y;
};

inline Opening filledOpening(const KM_Viewport& viewport) {
    double vertical = 0.0;
    double horizontal = 0.0;
    if (viewport.GetCameraHalfAngles(&vertical, &horizontal))
        return {FILL * std::tan(horizontal), FILL * std::tan(vertical)};
    return {FILL * viewport.FrustumAspect(), FILL};
}

/// How far points reach out as a camera sees them: sideways, up or down, toward it, and how far
/// from the target it must stand for the picture to hold them.
class Reach {
public:
    Reach(const KM_Viewport& camera, const KM_3dPoint& target)
        : Reach(camera, target, filledOpening(camera)) {}

    /// With another part of the picture to fill than all of it but the margin.
    Reach(const KM_Viewport& camera, const KM_3dPoint& target, const Opening& opening)
        : m_target(target), m_x(camera.CameraX()), m_y(camera.CameraY()), m_z(camera.CameraZ()),
          m_opening(opening), m_cos_elevation(std::hypot(camera.CameraZ().x, camera.CameraZ().y)),
          m_sin_elevation(camera.CameraZ().z) {}

    /// A point that stands still.
    void add(const KM_3dPoint& point) {
        const KM_3dVector v = point - m_target;
        const double x = std::abs(v * m_x);
        const double y = std::abs(v * m_y);
        const double z = v * m_z;
        take(x, y, z, v.LengthSquared());
        m_distance = std::max({m_distance, z + x / m_opening.x, z + y / m_opening.y});
    }

    /// A point that turns once about the vertical through the target. At the turning angle a it is
    /// seen at x = r sin a, y = h cos e - r cos a sin e, z = h sin e + r cos a cos e, where r is
    /// its distance from the vertical, h its height over the target and e the camera's elevation;
    /// each bound below is the largest value over all a.
    void addTurning(const KM_3dPoint& point) {
        const KM_3dVector v = point - m_target;
        const double r = std::hypot(v.x, v.y);
        const double rise = v.z * m_cos_elevation;
        const double toward = v.z * m_sin_elevation;
        take(r, r * std::abs(m_sin_elevation) + std::abs(rise), r * m_cos_elevation + toward,
             v.LengthSquared());
        const double sideways = r * std::hypot(m_cos_elevation, 1.0 / m_opening.x) + toward;
        const double slope = m_sin_elevation / m_opening.y;
        const double up = r * std::abs(m_cos_elevation - slope) + toward + rise / m_opening.y;
        const double down = r * std::abs(m_cos_elevation + slope) + toward - rise / m_opening.y;
        m_turn_sideways = std::max(m_turn_sideways, sideways);
        m_up = std::max(m_up, up);
        m_down = std::max(m_down, down);
        m_distance = std::max({m_distance, sideways, up, down});
    }

    /// How far the target must rise for turning points to ask for the same distance by reaching up
    /// as by reaching down. Raising it by s takes s (sin e + cos e / oy) from every bound upward,
    /// s (sin e - cos e / oy) from every bound downward and s sin e from every bound sideways,
    /// where oy is the height of the opening.
    double riseToMiddle() const { return (m_up - m_down) * m_opening.y / (2.0 * m_cos_elevation); }

    /// Whether turning points ask for at least as great a distance by reaching up and down as by
    /// reaching sideways, once the target has risen by riseToMiddle.
    bool isBoundByHeightInMiddle() const {
        const double rise = riseToMiddle();
        const double upright = m_up - rise * (m_sin_elevation + m_cos_elevation / m_opening.y);
        return upright >= m_turn_sideways - rise * m_sin_elevation;
    }

    /// Distance of a perspective camera from the target at which the picture holds all points.
    double distance(double clearance) const {
        return std::max({m_distance, m_toward + clearance, clearance});
    }
    /// Half the height of a parallel picture that holds all points; 0 for a single one.
    double parallelHalfHeight() const {
        return std::max(m_sideways / m_opening.x, m_upright / m_opening.y);
    }
    /// Of the farthest point from the target.
    double radius() const { return std::sqrt(m_radius_squared); }

private:
    void take(double sideways, double upright, double toward, double radius_squared) {
        m_sideways = std::max(m_sideways, sideways);
        m_upright = std::max(m_upright, upright);
        m_toward = std::max(m_toward, toward);
        m_radius_squared = std::max(m_radius_squared, radius_squared);
    }

    KM_3dPoint m_target;
    KM_3dVector m_x;
    KM_3dVector m_y;
    KM_3dVector m_z;
    Opening m_opening;
    double m_cos_elevation;
    double m_sin_elevation;
    double m_sideways = 0.0;
    double m_upright = 0.0;
    double m_toward = -HUGE_VAL;
    double m_distance = -HUGE_VAL;
    double m_turn_sideways = -HUGE_VAL;
    double m_up = -HUGE_VAL;
    double m_down = -HUGE_VAL;
    double m_radius_squared = 0.0;
};

} // namespace quarn
