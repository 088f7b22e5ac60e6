#include "zoetrix/paths/ZoetrixDynamicAccess.h"

#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnView.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <optional>

namespace {

bool HasFrame(const KM_3dmAnimationProperties& rec, int frame) {
    return frame >= 1 && frame <= rec.CameraPoints().Count() && frame <= rec.TargetPoints().Count();
}

/// A frame's two points and the view that they belong to.
struct FramePoints {
    CQuarnView* view = nullptr;
    KM_3dPoint camera;
    KM_3dPoint target;
};

/// The points of a frame, after the curves that they come from. The caller's record stays as it is:
/// a record that follows curves is copied, and only such a one, as its point lists may be long.
std::optional<FramePoints> PointsAtFrame(CQuarnDoc& doc, const KM_3dmAnimationProperties& rec,
                                         int frame) {
    if (!HasFrame(rec, frame))
        return std::nullopt;

    std::optional<KM_3dmAnimationProperties> refreshed;
    if (rec.FollowsCurves())
        CZoetrixUtilities::ResetAnimation(refreshed.emplace(rec));
    const KM_3dmAnimationProperties& current = refreshed ? *refreshed : rec;

    KM_wString view_name = current.ViewportName();
    view_name.TrimLeftAndRight();
    if (view_name.IsEmpty())
        return std::nullopt;
    CQuarnView* view = CZoetrixUtilities::FindQuarnViewByName(doc, view_name, true);
    if (!view)
        return std::nullopt;

    // A curve that can be evaluated in fewer places than before leaves shorter lists.
    const KM_3dPoint* camera = current.CameraPoints().At(frame - 1);
    const KM_3dPoint* target = current.TargetPoints().At(frame - 1);
    if (!camera || !target)
        return std::nullopt;
    return FramePoints{view, *camera, *target};
}

} // namespace

CZoetrixDynamicAccess::~CZoetrixDynamicAccess() = default;

const KM_3dmAnimationProperties&
CZoetrixDynamicAccess::AnimationProperties(const CQuarnDoc& doc) const {
    return ZoetrixPlugIn().AnimationProperties(doc);
}

void CZoetrixDynamicAccess::SetAnimationProperties(const CQuarnDoc& doc,
                                                   const KM_3dmAnimationProperties& rec) {
    ZoetrixPlugIn().SetAnimationProperties(doc, rec);
}

bool CZoetrixDynamicAccess::AnimatedViewAtFrame(CQuarnDoc& doc,
                                                const KM_3dmAnimationProperties& rec, int frame,
                                                KM_Viewport& out) {
    const std::optional<FramePoints> points = PointsAtFrame(doc, rec, frame);
    if (!points || rec.IsSunStudy())
        return false;

    const CQuarnViewport& viewport = points->view->ActiveViewport();
    out = viewport.VP();
    return SetTargetAndCameraLocation(viewport, points->target, points->camera, out);
}

bool CZoetrixDynamicAccess::AnimatedSunAtFrame(CQuarnDoc& doc, const KM_3dmAnimationProperties& rec,
                                               int frame, KM_Light& light) {
    const std::optional<FramePoints> points = PointsAtFrame(doc, rec, frame);
    if (!points || !rec.IsSunStudy())
        return false;

    light.SetStyle(KM_LightStyle::world_directional);
    light.SetLocation(points->camera);
    light.SetDirection(points->target - points->camera);
    return true;
}

void ReplaceLight(CQuarnDoc& doc, KM_3dmAnimationProperties& rec, KM_Light& light) {
    CQuarnLightTable& lights = doc.LightTable();
    if (rec.LightIndex() >= 0)
        lights.DeleteLight(rec.LightIndex(), true);
    rec.SetLightIndex(lights.AddLight(light, nullptr));
}
