#pragma once

#include "kelmar/KM_BoundingBox.h"

#include <algorithm>
#include <limits>

namespace quarn {

/// Gathers the box of many points, fast.
class Extent {
public:
    /// @param p  finite
    void add(const KM_3dPoint& p) {
        m_low = {std::min(m_low.x, p.x), std::min(m_low.y, p.y), std::min(m_low.z, p.z)};
        m_high = {std::max(m_high.x, p.x), std::max(m_high.y, p.y), std::max(m_high.z, p.z)};
    }

    /// Empty where there was no point.
    KM_BoundingBox box() const {
        return m_low.x <= m_high.x ? KM_BoundingBox(m_low, m_high) : KM_BoundingBox();
    }

private:
    static constexpr double FAR = std::numeric_limits<double>::max();

    KM_3dPoint m_low{FAR, FAR, FAR};
    KM_3dPoint m_high{-FAR, -FAR, -FAR};
};

} // namespace quarn
