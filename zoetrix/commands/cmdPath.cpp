#include "zoetrix/commands/cmdPath.h"

#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/CameraDialog.h"
#include "zoetrix/commands/CameraSetUp.h"
#include "zoetrix/commands/CommandGuard.h"
#include "zoetrix/commands/EndWith.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

namespace {

constexpr unsigned int points_and_curves =
    CQuarnGetObject::point_object | CQuarnGetObject::curve_object;

/// What camera or target follows: a curve, or a point at which it stays.
struct Followed {
    CQuarnObjRef object;
    bool is_curve = false;
    KM_3dPoint point; ///< where there is no curve
};

struct Paths {
    Followed camera;
    Followed target;
};

// ---- The objects

/// @return false when the object is neither curve nor point, or gone
bool Recognise(Followed& followed) {
    followed.is_curve = followed.object.Curve() != nullptr;
    if (followed.is_curve)
        return true;
    const KM_3dPoint* point = followed.object.Point();
    if (point)
        followed.point = *point;
    return point != nullptr;
}

/// The question for what camera or target follows, and what is told where nothing comes of it.
struct FollowQuestion {
    const wchar_t* prompt;
    int prompt_id;
    const wchar_t* failure;
    int failure_id;
};

constexpr FollowQuestion camera_question = {
    L"Select camera path curve or point. Press Enter to select last camera path", 40301,
    L"Failed to select camera path or point. Nothing done\n", 40302};
constexpr FollowQuestion target_question = {
    L"Select target path curve or point. Press Enter to select last target path", 40303,
    L"Failed to select target path or point. Nothing done\n", 40304};

/// Asks for one curve or point.
/// @param last_id  names the object that Enter takes
int AskFollowed(const FollowQuestion& question, const KM_UUID& last_id, Followed& followed) {
    const int asked = AskForPath(QnLocalizeString(question.prompt, question.prompt_id),
                                 points_and_curves, last_id, followed.object);
    if (asked == CQuarnCommand::success && Recognise(followed))
        return CQuarnCommand::success;
    return EndWith(question.failure, question.failure_id,
                   asked == CQuarnCommand::success ? CQuarnCommand::failure : asked);
}

// ---- At the command line

/// Repairs a sequence name that cannot be a file's name, and tells so.
int RepairNameOfRecord(KM_3dmAnimationProperties& props) {
    KM_wString name = props.HtmlFilename();
    const NameRepair repair = RepairName(name);
    if (repair == NameRepair::impossible)
        return EndWith(L"Failed. Invalid animation name\n", 40011, CQuarnCommand::cancel);
    if (repair == NameRepair::done) {
        const wchar_t* message = QnLocalizeString(
            L"The animation name (%s) has invalid letters. Changed to (%s)", 40306);
        QuarnApp().Print(
            KM_wString::FormatToString(message, props.HtmlFilename().Array(), name.Array()));
    }
    props.SetHtmlFilename(name);
    return CQuarnCommand::success;
}

int AskAtCommandLine(CQuarnDoc& doc, KM_3dmAnimationProperties& props, int& frame_count) {
    if (const int ended = AskFrameCount(frame_count); ended != CQuarnCommand::success)
        return ended;
    if (const int ended = GetAnimationOptions(doc, props, false); ended != CQuarnCommand::success)
        return ended;
    return RepairNameOfRecord(props);
}

// ---- The record

/// A place for every frame.
/// @return false when a curve yields none, or is gone since it was picked
bool GetPoints(const Followed& followed, int frame_count, bool is_camera, KM_3dPointArray& points) {
    if (followed.is_curve)
        return CZoetrixUtilities::GetPathPoints(followed.object.Curve(), frame_count, points, false,
                                                is_camera);
    points.Append(followed.point);
    points.Reserve(frame_count);
    while (points.Count() < frame_count)
        points.Append(followed.point);
    return true;
}

int SetFramePoints(const Paths& paths, int frame_count, KM_3dmAnimationProperties& props) {
    KM_3dPointArray camera_points;
    if (!GetPoints(paths.camera, frame_count, true, camera_points))
        return EndWithoutCameraPoints();
    KM_3dPointArray target_points;
    if (!GetPoints(paths.target, frame_count, false, target_points))
        return EndWith(L"Failed to divide target path. Nothing done\n", 40305,
                       CQuarnCommand::failure);
    props.CameraPoints() = camera_points;
    props.TargetPoints() = target_points;
    props.SetCameraPathId(paths.camera.object.ObjectUuid());
    props.SetTargetPathId(paths.target.object.ObjectUuid());
    return CQuarnCommand::success;
}

int SetUpPath(CQuarnDoc& doc, bool interactive) {
    KM_3dmAnimationProperties props = ZoetrixPlugIn().AnimationProperties(doc);
    Paths paths;
    if (const int ended = AskFollowed(camera_question, props.CameraPathId(), paths.camera);
        ended != CQuarnCommand::success)
        return ended;
    if (const int ended = AskFollowed(target_question, props.TargetPathId(), paths.target);
        ended != CQuarnCommand::success)
        return ended;

    // Between two points nothing moves.
    const bool moves = paths.camera.is_curve || paths.target.is_curve;
    int frame_count = moves ? props.FrameCount() : 1;
    const int asked = interactive ? AskInPathDialog(props, frame_count)
                                  : AskAtCommandLine(doc, props, frame_count);
    if (asked != CQuarnCommand::success)
        return asked;
    if (const int ended = SetFramePoints(paths, frame_count, props);
        ended != CQuarnCommand::success)
        return ended;
    StoreAnimation(doc, props, KM_3dmAnimationProperties::path, frame_count);
    return CQuarnCommand::success;
}

} // namespace

CCommandPathAnimation::CCommandPathAnimation() : CQuarnCommand(false, false, nullptr, false) {}

CCommandPathAnimation::~CCommandPathAnimation() = default;

KM_UUID CCommandPathAnimation::CommandUUID() {
    // BBFB4E20-1E39-4047-8109-D953556A2441
    return {0xBBFB4E20, 0x1E39, 0x4047, {0x81, 0x09, 0xD9, 0x53, 0x55, 0x6A, 0x24, 0x41}};
}

const wchar_t* CCommandPathAnimation::EnglishCommandName() {
    return L"SetPathAnimation";
}

const wchar_t* CCommandPathAnimation::CommandDescription() {
    return QnLocalizeString(L"Sets up an animation along a camera path", 40108);
}

CQuarnCommand::result CCommandPathAnimation::RunCommand(const CQuarnCommandContext& context) {
    return RunGuarded(
        [&context] { return SetUpPath(context.Document(), context.IsInteractive()); });
}
