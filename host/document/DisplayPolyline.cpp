#include "host/document/DisplayPolyline.h"

#include "engine/scene/DrawableRange.h"
#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Curve.h"

#include <algorithm>
#include <limits>

namespace quarn {

KM_3dPointArray displayPolyline(const KM_Curve& curve, double tolerance_of_size) {
    KM_3dPointArray points;
    const KM_BoundingBox box = curve.BoundingBox();
    if (!isInDrawableRange(box)) {
        points.Append(box.m_min);
        points.Append(box.m_max);
        return points;
    }
    // Without a tolerance a curve is divided as finely as can be: a share of the smallest sizes is
    // 0.
    const double tolerance =
        std::max(tolerance_of_size * box.Diagonal().Length(), std::numeric_limits<double>::min());
    curve.GetDisplayPolyline(tolerance, points);
    return points;
}

} // namespace quarn
