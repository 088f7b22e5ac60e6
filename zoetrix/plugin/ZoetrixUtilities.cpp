#include "zoetrix/plugin/ZoetrixUtilities.h"

#include "sdk/qncore/QnFileUtilities.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnObject.h"
#include "zoetrix/paths/FlythroughPoints.h"

namespace {

bool ResetFlythrough(KM_3dmAnimationProperties& props) {
    const CQuarnObjRef camera_path(props.CameraPathId());
    const KM_Curve* curve = camera_path.Curve();
    if (!curve)
        return true;

    KM_3dPointArray camera_points;
    KM_3dPointArray target_points;
    if (!GetFlythroughPoints(curve, props.FrameCount(), camera_points, target_points))
        return false;
    props.CameraPoints() = camera_points;
    props.TargetPoints() = target_points;
    return true;
}

/// Divides the curve with this id into `points`, which stay as they are when it yields none.
void ResetPathPoints(const KM_UUID& path_id, int frame_count, bool is_camera,
                     KM_3dPointArray& points) {
    const CQuarnObjRef path(path_id);
    KM_3dPointArray path_points;
    if (CZoetrixUtilities::GetPathPoints(path.Curve(), frame_count, path_points, false, is_camera))
        points = path_points;
}

void ResetPath(KM_3dmAnimationProperties& props) {
    // The points of a single frame stay where the set-up put them.
    if (props.FrameCount() == 1)
        return;
    ResetPathPoints(props.CameraPathId(), props.FrameCount(), true, props.CameraPoints());
    ResetPathPoints(props.TargetPathId(), props.FrameCount(), false, props.TargetPoints());
}

} // namespace

void CZoetrixUtilities::InitializeAnimationProperties(KM_3dmAnimationProperties& props) {
    props.SetCaptureMethod(QnLocalizeString(L"Wireframe", 32015));
    props.SetHtmlFilename(QnLocalizeString(L"Animation", 32016));

    KM_wString documents_folder;
    if (CQuarnFileUtilities::GetMyDocumentsFolder(documents_folder) &&
        CQuarnFileUtilities::DirExists(documents_folder))
        props.SetFolderName(documents_folder + L"/" + props.HtmlFilename());
}

bool CZoetrixUtilities::ResetAnimation(KM_3dmAnimationProperties& props) {
    switch (props.CaptureType()) {
    case KM_3dmAnimationProperties::flythrough:
        return ResetFlythrough(props);
    case KM_3dmAnimationProperties::path:
        ResetPath(props);
        return true;
    default:
        return true;
    }
}
