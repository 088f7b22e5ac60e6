// From places in the world to places in the picture, and back.

#include "kelmar/KM_Viewport.h"

#include <algorithm>
#include <cmath>

bool KM_Viewport::GetWorldFromCamera(KM_Xform& world_from_camera) const {
    if (!IsValidCamera())
        return false;
    const KM_3dVector columns[4] = {m_x, m_y, m_z, KM_3dVector(m_location)};
    KM_Xform xform;
    for (int column = 0; column < 4; ++column) {
        xform.m_xform[0][column] = columns[column].x;
        xform.m_xform[1][column] = columns[column].y;
        xform.m_xform[2][column] = columns[column].z;
    }
    world_from_camera = xform;
    return true;
}

bool KM_Viewport::GetCameraFromWorld(KM_Xform& camera_from_world) const {
    if (!IsValidCamera())
        return false;
    // The frame is orthonormal, so the inverse of its rotation is the transpose.
    const KM_3dVector rows[3] = {m_x, m_y, m_z};
    const KM_3dVector location(m_location);
    KM_Xform xform;
    for (int row = 0; row < 3; ++row) {
        xform.m_xform[row][0] = rows[row].x;
        xform.m_xform[row][1] = rows[row].y;
        xform.m_xform[row][2] = rows[row].z;
        xform.m_xform[row][3] = -(rows[row] * location);
    }
    camera_from_world = xform;
    return true;
}

bool KM_Viewport::GetClipFromCamera(KM_Xform& clip_from_camera) const {
    if (!IsValidCamera())
        return false;
    const double width = m_right - m_left;
    const double height = m_top - m_bottom;
    const double depth = m_far - m_near;
    KM_Xform xform;
    auto& m = xform.m_xform;
    if (IsPerspectiveProjection()) {
        m[0][0] = 2.0 * m_near / width;
        m[0][2] = (m_right + m_left) / width;
        m[1][1] = 2.0 * m_near / height;
        m[1][2] = (m_top + m_bottom) / height;
        m[2][2] = -(m_far + m_near) / depth;
        m[2][3] = -2.0 * m_far * m_near / depth;
        m[3][2] = -1.0;
        m[3][3] = 0.0;
    } else {
        m[0][0] = 2.0 / width;
        m[0][3] = -(m_right + m_left) / width;
        m[1][1] = 2.0 / height;
        m[1][3] = -(m_top + m_bottom) / height;
        m[2][2] = -2.0 / depth;
        m[2][3] = -(m_far + m_near) / depth;
    }
    clip_from_camera = xform;
    return true;
}

bool KM_Viewport::GetScreenFromWorld(KM_Xform& screen_from_world) const {
    KM_Xform clip_from_camera;
    KM_Xform camera_from_world;
    if (!GetClipFromCamera(clip_from_camera) || !GetCameraFromWorld(camera_from_world))
        return false;
    const double half_width = 0.5 * m_width_px;
    const double half_height = 0.5 * m_height_px;
    const KM_Xform screen_from_clip = KM_Xform::Translation(half_width, half_height, 0.0) *
                                      KM_Xform::Diagonal(half_width, -half_height, 1.0);
    screen_from_world = screen_from_clip * clip_from_camera * camera_from_world;
    return true;
}

bool KM_Viewport::WorldToScreen(const KM_3dPoint& point, double* x_px, double* y_px,
                                double* depth) const {
    if (!IsValidCamera() || !point.IsValid())
        return false;
    const KM_3dVector offset = point - m_location;
    const double distance = -(offset * m_z);
    if (IsPerspectiveProjection() && !(distance > 0.0))
        return false;
    const double scale = IsPerspectiveProjection() ? m_near / distance : 1.0;
    const double x = (scale * (offset * m_x) - m_left) / (m_right - m_left) * m_width_px;
    const double y = (m_top - scale * (offset * m_y)) / (m_top - m_bottom) * m_height_px;
    if (!KM_IsValid(x) || !KM_IsValid(y))
        return false;
    if (x_px)
        *x_px = x;
    if (y_px)
        *y_px = y;
    if (depth)
        *depth = distance;
    return true;
}

bool KM_Viewport::GetRay(double x_px, double y_px, KM_3dPoint& origin,
                         KM_3dVector& direction) const {
    if (!IsValidCamera() || !KM_IsValid(x_px) || !KM_IsValid(y_px))
        return false;
    const double u = std::lerp(m_left, m_right, x_px / m_width_px);
    const double v = std::lerp(m_top, m_bottom, y_px / m_height_px);
    const KM_3dVector across = u * m_x + v * m_y;
    if (IsParallelProjection()) {
        origin = m_location + across;
        direction = -m_z;
        return true;
    }
    KM_3dVector forward = across - m_near * m_z;
    if (!forward.Unitize())
        return false;
    origin = m_location;
    direction = forward;
    return true;
}

bool KM_Viewport::GetRay(double x_px, double y_px, KM_Line& near_to_far) const {
    KM_3dPoint origin;
    KM_3dVector direction;
    if (!GetRay(x_px, y_px, origin, direction))
        return false;
    // The planes are met where the part along the view direction reaches their distance.
    const KM_3dVector per_depth = direction / -(direction * m_z);
    near_to_far = KM_Line(origin + m_near * per_depth, origin + m_far * per_depth);
    return true;
}
