#include "engine/display/LinePick.h"

#include "kelmar/KM_Viewport.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// Lines are cut off at this share of the near distance, as they are drawn.
constexpr double SHARE_OF_NEAR = 0.01;

} // namespace

LinePick::LinePick(const KM_Viewport& camera, double x_px, double y_px)
    : m_location(camera.CameraLocation()), m_x(camera.CameraX()), m_y(camera.CameraY()),
      m_z(camera.CameraZ()), m_is_perspective(camera.IsPerspectiveProjection()), m_x_px(x_px),
      m_y_px(y_px) {
    double left = 0.0;
    double right = 0.0;
    double bottom = 0.0;
    double top = 0.0;
    double near_distance = 0.0;
    int width_px = 1;
    int height_px = 1;
    camera.GetFrustum(&left, &right, &bottom, &top, &near_distance, nullptr);
    camera.GetScreenPort(&width_px, &height_px);
    const double scale = m_is_perspective ? 1.0 / near_distance : 1.0;
    m_nearest = SHARE_OF_NEAR * near_distance;
    m_left = scale * left;
    m_top = scale * top;
    m_pixel_width = scale * (right - left) / width_px;
    m_pixel_height = scale * (top - bottom) / height_px;
}

double LinePick::pixelSizeAt(double depth) const {
    return m_is_perspective ? m_pixel_height * depth : m_pixel_height;
}

LinePick::Seen LinePick::see(const KM_3dPoint& point) const {
    const KM_3dVector from_camera = point - m_location;
    return {from_camera * m_x, from_camera * m_y, -(from_camera * m_z)};
}

std::optional<LineHit> LinePick::nearestOf(Seen a, Seen b) const {
    if (!isBefore(a) && !isBefore(b))
        return std::nullopt;
    const auto between = [](const Seen& from, const Seen& to, double t) {
        return Seen{from.x + t * (to.x - from.x), from.y + t * (to.y - from.y),
                    from.depth + t * (to.depth - from.depth)};
    };
    if (!isBefore(a))
        a = between(b, a, (m_nearest - b.depth) / (a.depth - b.depth));
    else if (!isBefore(b))
        b = between(a, b, (m_nearest - a.depth) / (b.depth - a.depth));

    // From the mouse, in pixels.
    const double scale_a = m_is_perspective ? 1.0 / a.depth : 1.0;
    const double scale_b = m_is_perspective ? 1.0 / b.depth : 1.0;
    const double ax = (a.x * scale_a - m_left) / m_pixel_width - m_x_px;
    const double ay = (m_top - a.y * scale_a) / m_pixel_height - m_y_px;
    const double dx = (b.x * scale_b - m_left) / m_pixel_width - m_x_px - ax;
    const double dy = (m_top - b.y * scale_b) / m_pixel_height - m_y_px - ay;
    const double length_squared = dx * dx + dy * dy;
    const double along =
        length_squared > 0.0 ? std::clamp(-(ax * dx + ay * dy) / length_squared, 0.0, 1.0) : 0.0;
    // Equal steps on the picture are no equal steps on a line that leads away from the camera.
    const double weight_b = along * scale_b;
    const Seen nearest = between(a, b, weight_b / ((1.0 - along) * scale_a + weight_b));
    return LineHit{std::hypot(ax + along * dx, ay + along * dy), nearest.depth,
                   m_location + nearest.x * m_x + nearest.y * m_y - nearest.depth * m_z};
}

std::optional<LineHit> LinePick::nearest(std::span<const KM_3dPoint> polyline) const {
    if (polyline.empty())
        return std::nullopt;
    std::optional<LineHit> best;
    Seen before = see(polyline.front());
    for (const KM_3dPoint& point : polyline.size() > 1 ? polyline.subspan(1) : polyline) {
        const Seen here = see(point);
        const std::optional<LineHit> hit = nearestOf(before, here);
        if (hit && (!best || hit->distance_px < best->distance_px))
            best = hit;
        before = here;
    }
    return best;
}

} // namespace quarn
