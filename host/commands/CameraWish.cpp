#include "host/commands/CameraWish.h"

#include "host/document/CameraMove.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

KM_3dPoint cameraTarget(const KM_Viewport& viewport) {
    const KM_3dPoint& target = viewport.TargetPoint();
    return target.IsValid() ? target : viewport.CameraLocation() + viewport.CameraDirection();
}

Result<void> fulfil(const CameraWish& wish, KM_Viewport& viewport) {
    if (wish.location || wish.target) {
        const KM_3dPoint target = wish.target.value_or(cameraTarget(viewport));
        const KM_3dPoint location = wish.location.value_or(viewport.CameraLocation());
        if (!moveCamera(viewport, target, location, true))
            return Error{KM_wString(QnLocalizeString(L"The camera cannot stand at its target. Give "
                                                     L"another location or target.",
                                                     42444))
                             .ToUtf8()};
        viewport.SetTargetPoint(target);
    }
    viewport.SetProjection(wish.parallel ? KM_parallel_view : KM_perspective_view);
    if (wish.lens_mm && !viewport.SetCamera35mmLensLength(*wish.lens_mm))
        return Error{"A parallel view has no lens. Set Parallel=No or leave Lens out."};
    return {};
}

} // namespace quarn
