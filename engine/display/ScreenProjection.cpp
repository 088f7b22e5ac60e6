#include "engine/display/ScreenProjection.h"

#include "engine/display/CameraRays.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

double dot(const double (&a)[3], const double (&b)[3]) {
    return a[0] * b[0] + a[1] * b[1] + a[2] * b[2];
}

} // namespace

ScreenProjection::ScreenProjection(const CameraRays& rays, int width, int height, float margin_px)
    : m_left(rays.left), m_top(rays.top), m_pixels_per_x(1.0 / rays.pixel_width),
      m_pixels_per_y(1.0 / rays.pixel_size), m_near(rays.line_near), m_far(rays.far_depth),
      m_parallel(rays.parallel), m_min(-margin_px), m_max_x(width + double{margin_px}),
      m_max_y(height + double{margin_px}), m_width(width), m_height(height) {
    std::copy_n(rays.eye, 3, m_eye);
    std::copy_n(rays.camera_x, 3, m_x);
    std::copy_n(rays.camera_y, 3, m_y);
    std::copy_n(rays.camera_z, 3, m_z);
}

ScreenProjection::CameraPoint ScreenProjection::cameraPoint(const double (&world)[3]) const {
    const double p[3] = {world[0] - m_eye[0], world[1] - m_eye[1], world[2] - m_eye[2]};
    return {dot(p, m_x), dot(p, m_y), -dot(p, m_z)};
}

ScreenProjection::PicturePoint ScreenProjection::picturePoint(const CameraPoint& p) const {
    const double scale = m_parallel ? 1.0 : 1.0 / p.depth;
    return {(p.x * scale - m_left) * m_pixels_per_x, (m_top - p.y * scale) * m_pixels_per_y,
            m_parallel ? m_far - p.depth : scale};
}

bool ScreenProjection::project(const double (&from)[3], const double (&to)[3],
                               ScreenSegment& segment) const {
    CameraPoint a = cameraPoint(from);
    CameraPoint b = cameraPoint(to);
    if (!m_parallel) {
        if (a.depth < m_near && b.depth < m_near)
            return false;
        const auto pulled = [this](const CameraPoint& behind, const CameraPoint& before) {
            const double t = (m_near - behind.depth) / (before.depth - behind.depth);
            return CameraPoint{behind.x + t * (before.x - behind.x),
                               behind.y + t * (before.y - behind.y), m_near};
        };
        if (a.depth < m_near)
            a = pulled(a, b);
        else if (b.depth < m_near)
            b = pulled(b, a);
    }
    return clipToPicture(picturePoint(a), picturePoint(b), segment);
}

float ScreenProjection::nearness(const double (&world)[3]) const {
    const double toward[3] = {m_eye[0] - world[0], m_eye[1] - world[1], m_eye[2] - world[2]};
    const double depth = dot(toward, m_z);
    if (m_parallel)
        return static_cast<float>(m_far - depth);
    return depth < m_near ? 0.0F : static_cast<float>(1.0 / depth);
}

bool ScreenProjection::project(const double (&world)[3], ScreenPoint& point) const {
    const CameraPoint camera_point = cameraPoint(world);
    if (!m_parallel && camera_point.depth < m_near)
        return false;
    const PicturePoint place = picturePoint(camera_point);
    if (!(place.x >= 0.0 && place.x < m_width && place.y >= 0.0 && place.y < m_height))
        return false;
    point = within(place);
    return true;
}

/// By Y.-D. Liang and B. A. Barsky, "A New Concept and Method for Line Clipping", 1984.
bool ScreenProjection::clipToPicture(const PicturePoint& a, const PicturePoint& b,
                                     ScreenSegment& segment) const {
    if (!std::isfinite(a.x + a.y + a.nearness + b.x + b.y + b.nearness))
        return false;
    double enter = 0.0;
    double leave = 1.0;
    const auto clip = [&](double start, double change, double limit, double inward) {
        const double distance = inward * (start - limit); // negative: outside
        const double slope = inward * change;
        if (slope == 0.0)
            return distance >= 0.0;
        const double t = -distance / slope;
        if (slope > 0.0)
            enter = std::max(enter, t);
        else
            leave = std::min(leave, t);
        return enter <= leave;
    };
    if (!clip(a.x, b.x - a.x, m_min, 1.0) || !clip(a.x, b.x - a.x, m_max_x, -1.0) ||
        !clip(a.y, b.y - a.y, m_min, 1.0) || !clip(a.y, b.y - a.y, m_max_y, -1.0))
        return false;
    const auto at = [&](double t) {
        return PicturePoint{a.x + t * (b.x - a.x), a.y + t * (b.y - a.y),
                            a.nearness + t * (b.nearness - a.nearness)};
    };
    segment = {within(enter > 0.0 ? at(enter) : a), within(leave < 1.0 ? at(leave) : b)};
    return true;
}

/// The ends of what was clipped lie on the border of the picture but for rounding, which is great
/// where the whole line is very long: the loops over its pixels rely on it.
ScreenPoint ScreenProjection::within(const PicturePoint& p) const {
    return {static_cast<float>(std::clamp(p.x, m_min, m_max_x)),
            static_cast<float>(std::clamp(p.y, m_min, m_max_y)), static_cast<float>(p.nearness),
            1.0F, 1.0F};
}

} // namespace quarn
