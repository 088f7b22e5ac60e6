#include "host/document/DisplayPolyline.h"

#include "engine/scene/DrawableRange.h"
#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Curve.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace quarn {

namespace {

/// No piece is nearer to the curve than rounding lets its points be: of a small curve far from the
/// origin all pieces would be divided for nothing.
double roundingIn(const KM_BoundingBox& box) {
    const double largest =
        std::max({std::abs(box.m_min.x), std::abs(box.m_min.y), std::abs(box.m_min.z),
                  std::abs(box.m_max.x), std::abs(box.m_max.y), std::abs(box.m_max.z)});
    return 8.0 * std::numeric_limits<double>::epsilon() * largest;
}

} // namespace

KM_3dPointArray displayPolyline(const KM_Curve& curve, double tolerance_of_size) {
    KM_3dPointArray points;
    const KM_BoundingBox box = curve.BoundingBox();
    if (!isInDrawableRange(box)) {
        points.Append(box.m_min);
        points.Append(box.m_max);
        return points;
    }
    const double tolerance = std::max({tolerance_of_size * box.Diagonal().Length(), roundingIn(box),
                                       std::numeric_limits<double>::min()});
    curve.GetDisplayPolyline(tolerance, points);
    return points;
}

} // namespace quarn
