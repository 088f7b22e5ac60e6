#include "zoetrix/commands/cmdFlyThru.h"

#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/CameraDialog.h"
#include "zoetrix/commands/CameraSetUp.h"
#include "zoetrix/commands/CommandGuard.h"
#include "zoetrix/commands/EndWith.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/paths/FlythroughPoints.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"

namespace {

int AskPath(const KM_3dmAnimationProperties& props, CQuarnObjRef& path) {
    const int asked =
        AskForPath(QnLocalizeString(L"Select path curve for camera and target", 40307),
                   CQuarnGetObject::curve_object, props.CameraPathId(), path);
    if (asked != CQuarnCommand::success)
        return EndWith(L"Failed to select path. Nothing done\n", 40308, asked);
    if (!path.Curve())
        return EndWith(L"Failed to select camera path or point. Nothing done\n", 40302,
                       CQuarnCommand::failure);
    return CQuarnCommand::success;
}

int AskAtCommandLine(CQuarnDoc& doc, KM_3dmAnimationProperties& props, int& frame_count) {
    if (const int ended = AskFrameCount(frame_count); ended != CQuarnCommand::success)
        return ended;
    return GetAnimationOptions(doc, props, false);
}

bool SetFramePoints(const CQuarnObjRef& path, int frame_count, KM_3dmAnimationProperties& props) {
    KM_3dPointArray camera_points;
    KM_3dPointArray target_points;
    if (!GetFlythroughPoints(path.Curve(), frame_count, camera_points, target_points))
        return false;
    props.CameraPoints() = camera_points;
    props.TargetPoints() = target_points;
    props.SetCameraPathId(path.ObjectUuid());
    props.SetTargetPathId(path.ObjectUuid());
    return true;
}

int SetUpFlythrough(CQuarnDoc& doc, bool interactive) {
    KM_3dmAnimationProperties props = ZoetrixPlugIn().AnimationProperties(doc);
    CQuarnObjRef path;
    if (const int ended = AskPath(props, path); ended != CQuarnCommand::success)
        return ended;

    int frame_count = props.FrameCount();
    const int asked = interactive ? AskInPathDialog(props, frame_count)
                                  : AskAtCommandLine(doc, props, frame_count);
    if (asked != CQuarnCommand::success)
        return asked;
    if (!SetFramePoints(path, frame_count, props))
        return EndWithoutCameraPoints();
    StoreAnimation(doc, props, KM_3dmAnimationProperties::flythrough, frame_count);
    return CQuarnCommand::success;
}

} // namespace

CCommandFlythroughAnimation::CCommandFlythroughAnimation()
    : CQuarnCommand(false, false, nullptr, false) {}

CCommandFlythroughAnimation::~CCommandFlythroughAnimation() = default;

KM_UUID CCommandFlythroughAnimation::CommandUUID() {
    // 66C3E01D-DE14-43D9-B796-DA7B7411E343
    return {0x66C3E01D, 0xDE14, 0x43D9, {0xB7, 0x96, 0xDA, 0x7B, 0x74, 0x11, 0xE3, 0x43}};
}

const wchar_t* CCommandFlythroughAnimation::EnglishCommandName() {
    return L"SetFlythroughAnimation";
}

const wchar_t* CCommandFlythroughAnimation::CommandDescription() {
    return QnLocalizeString(L"Sets up a flight along a curve", 40109);
}

CQuarnCommand::result CCommandFlythroughAnimation::RunCommand(const CQuarnCommandContext& context) {
    return RunGuarded(
        [&context] { return SetUpFlythrough(context.Document(), context.IsInteractive()); });
}
