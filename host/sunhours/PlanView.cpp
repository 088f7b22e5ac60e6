#include "host/sunhours/PlanView.h"

#include <algorithm>

namespace quarn {

KM_Viewport planView(const KM_BoundingBox& box, int width_px, int height_px) {
    constexpr double ROOM = 1.04;
    const KM_3dVector size = box.Diagonal();
    const double aspect = static_cast<double>(width_px) / height_px;
    const double half = 0.5 * ROOM * std::max({size.y, size.x / aspect, 1e-6 * size.Length()});
    KM_Viewport view;
    view.SetProjection(KM_parallel_view);
    view.SetCameraLocation(box.Center() + KM_3dVector(0, 0, size.z + half));
    view.SetCameraDirection(KM_3dVector(0, 0, -1));
    view.SetCameraUp(KM_3dVector::YAxis);
    view.SetFrustum(-half * aspect, half * aspect, -half, half, 0.001 * half,
                    2.0 * (size.z + half));
    return view;
}

} // namespace quarn
