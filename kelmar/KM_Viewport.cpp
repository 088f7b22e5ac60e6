#include "kelmar/KM_Viewport.h"

#include <algorithm>
#include <cmath>

namespace {

// Directions whose angle has a sine up to this count as parallel.
constexpr double parallel_sine = 1e-9;

// Half the height of the film that SetCamera35mmLensLength speaks of.
constexpr double half_film_mm = 12.0;

bool areValid(std::initializer_list<double> numbers) {
    return std::all_of(numbers.begin(), numbers.end(), KM_IsValid);
}

void store(double* place, double value) {
    if (place)
        *place = value;
}

// Unit vectors of the camera frame; false when the directions are parallel, zero or invalid.
bool makeFrame(const KM_3dVector& direction, const KM_3dVector& up, KM_3dVector& x, KM_3dVector& y,
               KM_3dVector& z) {
    KM_3dVector back = -direction;
    KM_3dVector upward = up;
    if (!back.Unitize() || !upward.Unitize())
        return false;
    KM_3dVector right = KM_CrossProduct(upward, back);
    if (right.Length() <= parallel_sine || !right.Unitize())
        return false;
    x = right;
    y = KM_CrossProduct(back, right);
    y.Unitize();
    z = back;
    return true;
}

} // namespace

KM_Viewport::KM_Viewport() {
    UpdateFrame();
}

bool KM_Viewport::UpdateFrame() {
    m_frame_is_current = makeFrame(m_direction, m_up, m_x, m_y, m_z);
    return m_frame_is_current;
}

bool KM_Viewport::SetCameraLocation(const KM_3dPoint& location) {
    if (m_location_locked || !location.IsValid())
        return false;
    m_location = location;
    return true;
}

bool KM_Viewport::SetCameraDirection(const KM_3dVector& direction) {
    if (m_direction_locked || !direction.IsValid() || direction.IsZero())
        return false;
    m_direction = direction;
    UpdateFrame();
    return true;
}

bool KM_Viewport::SetCameraUp(const KM_3dVector& up) {
    KM_3dVector x, y, z;
    if (m_up_locked || !makeFrame(m_direction, up, x, y, z))
        return false;
    m_up = up;
    return UpdateFrame();
}

bool KM_Viewport::SetTargetPoint(const KM_3dPoint& target) {
    if (!target.IsValid() && target != KM_3dPoint::UnsetPoint)
        return false;
    m_target = target;
    return true;
}

double KM_Viewport::TargetDistance() const {
    if (!IsValidCamera() || !m_target.IsValid())
        return KM_UNSET_VALUE;
    return (m_location - m_target) * m_z;
}

bool KM_Viewport::SetProjection(KM_ViewProjection projection) {
    if (projection != KM_parallel_view && projection != KM_perspective_view)
        return false;
    if (projection == m_projection)
        return true;
    m_projection = projection;
    // A parallel view may begin behind the camera, a perspective one may not.
    if (IsPerspectiveProjection() && m_near <= 0.0) {
        m_far = m_far > 0.0 ? m_far : 1000.0;
        m_near = 1e-4 * m_far;
    }
    const double distance = TargetDistance();
    if (KM_IsValid(distance) && distance > 0.0 && m_near > 0.0)
        ScaleOpening(IsPerspectiveProjection() ? m_near / distance : distance / m_near);
    return true;
}

// An opening that would have no size, or one without end, stays as it is.
void KM_Viewport::ScaleOpening(double factor) {
    SetFrustum(factor * m_left, factor * m_right, factor * m_bottom, factor * m_top, m_near, m_far);
}

bool KM_Viewport::GetFrustum(double* left, double* right, double* bottom, double* top,
                             double* near_distance, double* far_distance) const {
    store(left, m_left);
    store(right, m_right);
    store(bottom, m_bottom);
    store(top, m_top);
    store(near_distance, m_near);
    store(far_distance, m_far);
    return true;
}

bool KM_Viewport::SetFrustum(double left, double right, double bottom, double top,
                             double near_distance, double far_distance) {
    if (!areValid({left, right, bottom, top, near_distance, far_distance}) || left >= right ||
        bottom >= top || near_distance >= far_distance)
        return false;
    if (IsPerspectiveProjection() && near_distance <= 0.0)
        return false;
    m_left = left;
    m_right = right;
    m_bottom = bottom;
    m_top = top;
    m_near = near_distance;
    m_far = far_distance;
    return true;
}

bool KM_Viewport::SetFrustumNearFar(double near_distance, double far_distance) {
    const double scale = IsPerspectiveProjection() ? near_distance / m_near : 1.0;
    return SetFrustum(scale * m_left, scale * m_right, scale * m_bottom, scale * m_top,
                      near_distance, far_distance);
}

double KM_Viewport::FrustumAspect() const {
    return (m_right - m_left) / (m_top - m_bottom);
}

bool KM_Viewport::SetFrustumAspect(double width_over_height) {
    if (!KM_IsValid(width_over_height) || width_over_height <= 0.0)
        return false;
    const double smaller = std::min(m_right - m_left, m_top - m_bottom);
    const double half_width = 0.5 * smaller * std::max(width_over_height, 1.0);
    const double half_height = 0.5 * smaller / std::min(width_over_height, 1.0);
    const double middle_x = 0.5 * (m_left + m_right);
    const double middle_y = 0.5 * (m_bottom + m_top);
    return SetFrustum(middle_x - half_width, middle_x + half_width, middle_y - half_height,
                      middle_y + half_height, m_near, m_far);
}

bool KM_Viewport::GetCameraHalfAngles(double* vertical, double* horizontal) const {
    if (!IsPerspectiveProjection())
        return false;
    store(vertical, std::atan(0.5 * (m_top - m_bottom) / m_near));
    store(horizontal, std::atan(0.5 * (m_right - m_left) / m_near));
    return true;
}

bool KM_Viewport::GetCamera35mmLensLength(double* lens_length_mm) const {
    if (!IsPerspectiveProjection())
        return false;
    const double smaller = std::min(m_right - m_left, m_top - m_bottom);
    store(lens_length_mm, half_film_mm * m_near / (0.5 * smaller));
    return true;
}

bool KM_Viewport::SetCamera35mmLensLength(double lens_length_mm) {
    if (!IsPerspectiveProjection() || !KM_IsValid(lens_length_mm) || lens_length_mm <= 0.0)
        return false;
    const double aspect = FrustumAspect();
    const double smaller = m_near * half_film_mm / lens_length_mm;
    const double half_width = smaller * std::max(aspect, 1.0);
    const double half_height = smaller / std::min(aspect, 1.0);
    return SetFrustum(-half_width, half_width, -half_height, half_height, m_near, m_far);
}

void KM_Viewport::GetScreenPort(int* width_px, int* height_px) const {
    if (width_px)
        *width_px = m_width_px;
    if (height_px)
        *height_px = m_height_px;
}

bool KM_Viewport::SetScreenPort(int width_px, int height_px) {
    if (width_px <= 0 || height_px <= 0 ||
        !SetFrustumAspect(static_cast<double>(width_px) / height_px))
        return false;
    m_width_px = width_px;
    m_height_px = height_px;
    return true;
}
