#include "engine/display/ScreenProjection.h"

#include "engine/display/CameraRays.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

double dot(const double (&a)[3], const double (&b)[3]) {
    return a[0] * b[0] + a[1] * b[1] + a[2] * b[2];
}

ScreenPoint between(const ScreenPoint& a, const ScreenPoint& b, float t) {
    return {a.x + t * (b.x - a.x), a.y + t * (b.y - a.y),
            a.nearness + t * (b.nearness - a.nearness), a.strength + t * (b.strength - a.strength),
            a.growth + t * (b.growth - a.growth)};
}

} // namespace

ScreenProjection::ScreenProjection(const CameraRays& rays, int width, int height, float margin_px)
    : m_left(rays.left), m_top(rays.top), m_pixels_per_x(1.0 / rays.pixel_width),
      m_pixels_per_y(1.0 / rays.pixel_size), m_near(rays.line_near), m_far(rays.far_depth),
      m_parallel(rays.parallel), m_min(-margin_px), m_max_x(static_cast<float>(width) + margin_px),
      m_max_y(static_cast<float>(height) + margin_px), m_width(static_cast<float>(width)),
      m_height(static_cast<float>(height)) {
    std::copy_n(rays.eye, 3, m_eye);
    std::copy_n(rays.camera_x, 3, m_x);
    std::copy_n(rays.camera_y, 3, m_y);
    std::copy_n(rays.camera_z, 3, m_z);
}

ScreenProjection::CameraPoint ScreenProjection::cameraPoint(const double (&world)[3]) const {
    const double p[3] = {world[0] - m_eye[0], world[1] - m_eye[1], world[2] - m_eye[2]};
    return {dot(p, m_x), dot(p, m_y), -dot(p, m_z)};
}

ScreenPoint ScreenProjection::screenPoint(const CameraPoint& p) const {
    const double scale = m_parallel ? 1.0 : 1.0 / p.depth;
    return {static_cast<float>((p.x * scale - m_left) * m_pixels_per_x),
            static_cast<float>((m_top - p.y * scale) * m_pixels_per_y),
            static_cast<float>(m_parallel ? m_far - p.depth : scale), 1.0F, 1.0F};
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
    segment = {screenPoint(a), screenPoint(b)};
    return clipToPicture(segment);
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
    point = screenPoint(camera_point);
    return point.x >= 0.0F && point.x < m_width && point.y >= 0.0F && point.y < m_height;
}

/// By Y.-D. Liang and B. A. Barsky, "A New Concept and Method for Line Clipping", 1984.
bool ScreenProjection::clipToPicture(ScreenSegment& segment) const {
    const ScreenPoint a = segment.from;
    const ScreenPoint b = segment.to;
    const float sum = a.x + a.y + a.nearness + b.x + b.y + b.nearness;
    if (!std::isfinite(sum))
        return false;
    float enter = 0.0F;
    float leave = 1.0F;
    const auto clip = [&](float start, float change, float limit, float inward) {
        const float distance = inward * (start - limit); // negative: outside
        const float slope = inward * change;
        if (slope == 0.0F)
            return distance >= 0.0F;
        const float t = -distance / slope;
        if (slope > 0.0F)
            enter = std::max(enter, t);
        else
            leave = std::min(leave, t);
        return enter <= leave;
    };
    if (!clip(a.x, b.x - a.x, m_min, 1.0F) || !clip(a.x, b.x - a.x, m_max_x, -1.0F) ||
        !clip(a.y, b.y - a.y, m_min, 1.0F) || !clip(a.y, b.y - a.y, m_max_y, -1.0F))
        return false;
    if (leave < 1.0F)
        segment.to = between(a, b, leave);
    if (enter > 0.0F)
        segment.from = between(a, b, enter);
    return true;
}

} // namespace quarn
