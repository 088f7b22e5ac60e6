#include "zoetrix/commands/cmdTurntable.h"

#include "kelmar/KM_Circle.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_Xform.h"
#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnView.h"
#include "zoetrix/commands/CameraDialog.h"
#include "zoetrix/commands/CameraSetUp.h"
#include "zoetrix/commands/CommandGuard.h"
#include "zoetrix/commands/EndWith.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <memory>

namespace {

/// Index of a direction in the dialog's list.
enum Direction : int { turns_clockwise = 0, turns_anticlockwise = 1 };

/// The direction chosen last, for all documents, from the load of the plug-in on.
bool& RemembersClockwise() {
    static bool clockwise = true;
    return clockwise;
}

// ---- The circle

/// The camera of the view that is turned about.
struct Eye {
    KM_3dPoint location;
    KM_3dPoint target;
};

/// Turns the circle about its centre so that it starts and ends at the camera's location.
void StartAt(KM_NurbsCurve& circle, const KM_3dPoint& centre, const KM_3dPoint& location) {
    const KM_3dPoint start = circle.PointAtStart();
    circle.Transform(KM_Xform::Rotation(start - centre, location - centre, centre));
    // Rounding must not move the seam, which is the last frame, off the camera's own place.
    circle.SetCV(0, location);
    circle.SetCV(circle.CVCount() - 1, location);
}

/// The horizontal circle at the camera's height about the vertical through the target. It starts at
/// the camera and runs anticlockwise seen from above.
/// @return null when the camera stands within the tolerance of that vertical, or nowhere
std::unique_ptr<KM_NurbsCurve> MakeCircle(const Eye& eye, double tolerance) {
    if (!eye.location.IsValid() || !eye.target.IsValid())
        return nullptr;
    KM_Plane plane = KM_xy_plane;
    const KM_Xform drop = KM_Xform::PlanarProjection(plane);
    KM_3dPoint target_below = eye.target;
    target_below.Transform(drop);
    plane.SetOrigin(target_below);
    KM_3dPoint location_below = eye.location;
    location_below.Transform(drop);
    const double radius = location_below.DistanceTo(target_below);
    if (radius < tolerance)
        return nullptr;

    plane.Translate(eye.location - location_below);
    std::unique_ptr<KM_NurbsCurve> circle(KM_NurbsCurve::New());
    if (!KM_Circle(plane, radius).GetNurbForm(*circle))
        return nullptr;
    StartAt(*circle, plane.Origin(), eye.location);
    return circle;
}

/// @return whether the active view has a camera; `eye` is set then
bool GetActiveEye(Eye& eye) {
    CQuarnView* view = QuarnApp().ActiveView();
    if (!view)
        return false;
    const KM_Viewport& viewport = view->ActiveViewport().VP();
    eye = {viewport.CameraLocation(), viewport.TargetPoint()};
    return true;
}

// ---- At the command line

/// Asks for the direction. Only "AntiClockwise" changes what is remembered: "Clockwise" keeps it,
/// as Enter does. So after one anticlockwise turntable the next ones turn anticlockwise too,
/// whatever is picked here; the dialog can turn them back.
int AskDirection() {
    CQuarnGetOption prompt;
    prompt.SetCommandPrompt(QnLocalizeString(L"Direction", 40007));
    prompt.SetDefaultString(QnLocalizeString(L"Clockwise", 40008));
    prompt.AcceptNothing(true);
    prompt.AddCommandOption(QnLocalizeCommandOptionName(L"Clockwise", 40201));
    const int anticlockwise =
        prompt.AddCommandOption(QnLocalizeCommandOptionName(L"AntiClockwise", 40202));
    prompt.GetOption();
    if (prompt.CommandResult() != CQuarnCommand::success)
        return EndWith(L"Failed to select direction. Nothing done\n", 40010,
                       prompt.CommandResult());
    const CQuarnCommandOption* picked = prompt.Option();
    if (prompt.Result() == CQuarnGet::option && picked && picked->m_option_index == anticlockwise)
        RemembersClockwise() = false;
    return CQuarnCommand::success;
}

int AskAtCommandLine(CQuarnDoc& doc, KM_3dmAnimationProperties& props, int& frame_count) {
    if (const int ended = AskFrameCount(frame_count); ended != CQuarnCommand::success)
        return ended;
    if (const int ended = AskDirection(); ended != CQuarnCommand::success)
        return ended;
    return GetAnimationOptions(doc, props, false);
}

// ---- In the dialog

int AskInTurntableDialog(KM_3dmAnimationProperties& props, int& frame_count) {
    KM_ClassArray<KM_wString> directions;
    directions.Append(QnLocalizeString(L"Clockwise", 40008));
    directions.Append(QnLocalizeString(L"AntiClockwise", 40009));
    CZoetrixDataUI lists;
    lists.SetDirectionList(directions);
    lists.SetDirectionListSelection(RemembersClockwise() ? turns_clockwise : turns_anticlockwise);

    const int asked =
        AskInDialog({QnZoetrixVexUiTurnTable, PreviewRenders::preview}, lists, props, frame_count);
    if (asked == CQuarnCommand::success)
        RemembersClockwise() = lists.DirectionListSelection() == turns_clockwise;
    return asked;
}

// ---- The record

/// Divides the circle into the camera's places. The camera looks at the same target from each.
/// @return false when the circle could not be divided
bool SetFramePoints(KM_3dmAnimationProperties& props, KM_NurbsCurve& circle, const Eye& eye,
                    int frame_count) {
    if (!RemembersClockwise())
        circle.Reverse();

    KM_3dPointArray camera_points;
    if (frame_count == 1)
        camera_points.Append(eye.location);
    else if (!CZoetrixUtilities::GetPathPoints(&circle, frame_count, camera_points, false, true))
        return false;

    KM_3dPointArray target_points;
    target_points.Reserve(frame_count);
    while (target_points.Count() < frame_count)
        target_points.Append(eye.target);
    props.CameraPoints() = camera_points;
    props.TargetPoints() = target_points;
    return true;
}

int SetUpTurntable(CQuarnDoc& doc, bool interactive) {
    KM_3dmAnimationProperties props = ZoetrixPlugIn().AnimationProperties(doc);
    Eye eye;
    const std::unique_ptr<KM_NurbsCurve> circle =
        GetActiveEye(eye) ? MakeCircle(eye, doc.AbsoluteTolerance()) : nullptr;
    if (!circle)
        return EndWith(L"Failed to create valid camera path in this view. Nothing done\n", 40013,
                       CQuarnCommand::failure);

    int frame_count = props.FrameCount();
    const int asked = interactive ? AskInTurntableDialog(props, frame_count)
                                  : AskAtCommandLine(doc, props, frame_count);
    if (asked != CQuarnCommand::success)
        return asked;
    if (!SetFramePoints(props, *circle, eye, frame_count))
        return EndWithoutCameraPoints();
    StoreAnimation(doc, props, KM_3dmAnimationProperties::turntable, frame_count);
    return CQuarnCommand::success;
}

} // namespace

CCommandTurntableAnimation::CCommandTurntableAnimation()
    : CQuarnCommand(false, false, nullptr, false) {}

CCommandTurntableAnimation::~CCommandTurntableAnimation() = default;

KM_UUID CCommandTurntableAnimation::CommandUUID() {
    // 24E39B43-B4C1-44AC-8479-4CB1AB388ED5
    return {0x24E39B43, 0xB4C1, 0x44AC, {0x84, 0x79, 0x4C, 0xB1, 0xAB, 0x38, 0x8E, 0xD5}};
}

const wchar_t* CCommandTurntableAnimation::EnglishCommandName() {
    return L"SetTurntableAnimation";
}

const wchar_t* CCommandTurntableAnimation::CommandDescription() {
    return QnLocalizeString(L"Sets up a turn of the camera around its target", 40112);
}

CQuarnCommand::result CCommandTurntableAnimation::RunCommand(const CQuarnCommandContext& context) {
    return RunGuarded(
        [&context] { return SetUpTurntable(context.Document(), context.IsInteractive()); });
}
