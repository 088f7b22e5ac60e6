#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <cmath>
#include <cstdint>
#include <new>
#include <stdexcept>

namespace {

/// Equal steps over a curve's domain, and the range of them that is wanted.
struct ParameterSteps {
    double min = 0.0;
    double max = 0.0;
    double step = 0.0;
    // Wider than a frame count, which one step more must not overflow.
    std::int64_t count = 0; ///< steps including both ends; at least 2
    std::int64_t first = 0;
    std::int64_t last = 0; ///< behind the last one wanted

    /// The end is met exactly: rounding could carry the last step beyond the domain.
    double ParameterAt(std::int64_t index) const {
        return index == count - 1 ? max : min + static_cast<double>(index) * step;
    }
};

ParameterSteps DivideDomain(const KM_Curve& curve, int frame_count, bool look_ahead,
                            bool is_camera) {
    const std::int64_t extra = look_ahead || curve.IsClosed() ? 1 : 0;
    const KM_Interval domain = curve.Domain();
    ParameterSteps steps;
    steps.min = domain.Min();
    steps.max = domain.Max();
    steps.count = frame_count + extra;
    steps.step = std::fabs(steps.max - steps.min) / static_cast<double>(steps.count - 1);
    const bool leaves_out_the_end = look_ahead && is_camera;
    steps.first = leaves_out_the_end ? 0 : extra;
    steps.last = leaves_out_the_end ? steps.count - 1 : steps.count;
    return steps;
}

void AppendPoints(const KM_Curve& curve, const ParameterSteps& steps, KM_3dPointArray& points) {
    for (std::int64_t i = steps.first; i < steps.last; ++i) {
        const KM_3dPoint point = curve.PointAt(steps.ParameterAt(i));
        if (!point.IsValid())
            continue;
        // All at once, so that a count that memory cannot hold is refused at the first point; but
        // a curve that yields no point asks for no memory.
        if (points.IsEmpty())
            points.Reserve(static_cast<int>(steps.last - steps.first));
        points.Append(point);
    }
}

} // namespace

bool CZoetrixUtilities::GetPathPoints(const KM_Curve* curve, int count, KM_3dPointArray& points,
                                      bool look_ahead, bool is_camera) try {
    if (!curve)
        return false;
    points.Empty();
    if (count <= 0)
        return false;
    if (count == 1) {
        points.Append(curve->PointAtStart());
        return true;
    }

    const ParameterSteps steps = DivideDomain(*curve, count, look_ahead, is_camera);
    if (!KM_IsValid(steps.min) || !KM_IsValid(steps.step))
        return false;
    AppendPoints(*curve, steps, points);
    return points.Count() > 0;
} catch (const std::bad_alloc&) {
    points.Destroy();
    return false;
} catch (const std::length_error&) {
    points.Destroy();
    return false;
}
