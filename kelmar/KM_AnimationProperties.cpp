#include "kelmar/KM_AnimationProperties.h"

KM_3dmAnimationProperties::KM_3dmAnimationProperties() = default;

KM_3dmAnimationProperties::KM_3dmAnimationProperties(const KM_3dmAnimationProperties& other) =
    default;

KM_3dmAnimationProperties&
KM_3dmAnimationProperties::operator=(const KM_3dmAnimationProperties& other) = default;

KM_3dmAnimationProperties&
KM_3dmAnimationProperties::operator=(KM_3dmAnimationProperties&& other) noexcept = default;

KM_3dmAnimationProperties::~KM_3dmAnimationProperties() = default;

bool KM_3dmAnimationProperties::IsSunStudy() const {
    return m_capture_type == one_day_sun || m_capture_type == seasonal_sun;
}

bool KM_3dmAnimationProperties::IsPlayable() const {
    return m_frame_count > 0 && m_camera_points.Count() == m_frame_count &&
           m_target_points.Count() == m_frame_count;
}

bool KM_3dmAnimationProperties::FollowsCurves() const {
    switch (m_capture_type) {
    case path:
        return !KM_UuidIsNil(m_camera_path_id) && !KM_UuidIsNil(m_target_path_id);
    case flythrough:
        return !KM_UuidIsNil(m_camera_path_id);
    default:
        return false;
    }
}

KM_SimpleArray<KM_UUID> KM_3dmAnimationProperties::FollowedCurves() const {
    KM_SimpleArray<KM_UUID> curves;
    if (!FollowsCurves())
        return curves;
    curves.Append(m_camera_path_id);
    if (m_capture_type == path)
        curves.Append(m_target_path_id);
    return curves;
}
