#include "kelmar/KM_BoundingBox.h"

#include <algorithm>

constinit const KM_BoundingBox KM_BoundingBox::EmptyBoundingBox;

bool KM_BoundingBox::IsValid() const {
    return m_min.IsValid() && m_max.IsValid() && m_min.x <= m_max.x && m_min.y <= m_max.y &&
           m_min.z <= m_max.z;
}

KM_3dPoint KM_BoundingBox::Center() const {
    if (!IsValid())
        return KM_3dPoint::UnsetPoint;
    // Halved before they are added: the sum could overflow.
    return 0.5 * m_min + 0.5 * KM_3dVector(m_max);
}

KM_3dVector KM_BoundingBox::Diagonal() const {
    return IsValid() ? m_max - m_min : KM_3dVector::ZeroVector;
}

bool KM_BoundingBox::Set(const KM_3dPoint& point, bool grow) {
    if (!point.IsValid())
        return false;
    if (grow && IsValid())
        return Union(KM_BoundingBox(point, point));
    m_min = m_max = point;
    return true;
}

bool KM_BoundingBox::Union(const KM_BoundingBox& other) {
    if (!other.IsValid())
        return IsValid();
    if (!IsValid()) {
        *this = other;
        return true;
    }
    m_min = {std::min(m_min.x, other.m_min.x), std::min(m_min.y, other.m_min.y),
             std::min(m_min.z, other.m_min.z)};
    m_max = {std::max(m_max.x, other.m_max.x), std::max(m_max.y, other.m_max.y),
             std::max(m_max.z, other.m_max.z)};
    return true;
}

bool KM_BoundingBox::Includes(const KM_3dPoint& point) const {
    return IsValid() && m_min.x <= point.x && point.x <= m_max.x && m_min.y <= point.y &&
           point.y <= m_max.y && m_min.z <= point.z && point.z <= m_max.z;
}

KM_3dPoint KM_BoundingBox::Corner(int index) const {
    return {index & 1 ? m_max.x : m_min.x, index & 2 ? m_max.y : m_min.y,
            index & 4 ? m_max.z : m_min.z};
}
