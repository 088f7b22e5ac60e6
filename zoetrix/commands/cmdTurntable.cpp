#include "zoetrix/commands/cmdTurntable.h"

#include "kelmar/KM_Circle.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_Xform.h"
#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnView.h"
#include "zoetrix/commands/CommandGuard.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"
#include "zoetrix/ui/ZoetrixDataUI.h"

#include <cstdlib>
#include <memory>

namespace {

/// Index of a direction in the dialog's list.
enum Direction : int { turns_clockwise = 0, turns_anticlockwise = 1 };

/// The direction chosen last, for all documents, from the load of the plug-in on.
bool& RemembersClockwise() {
    static bool clockwise = true;
    return clockwise;
}

int EndWith(const wchar_t* text, int id, int ended) {
    QuarnApp().Print(QnLocalizeString(text, id));
    return ended;
}

void ShowNameMessage(const wchar_t* text) {
    QuarnMessageBox(text, QnLocalizeString(L"Animation", 40002), 0);
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

int AskFrameCount(int& frame_count) {
    CQuarnGetInteger prompt;
    prompt.SetCommandPrompt(QnLocalizeString(L"Number of frames", 40005));
    prompt.SetDefaultInteger(frame_count);
    prompt.SetLowerLimit(1.0, true);
    prompt.GetNumber();
    if (prompt.CommandResult() != CQuarnCommand::success)
        return EndWith(L"Invalid number of frames. Nothing done\n", 40006, prompt.CommandResult());
    frame_count = std::abs(prompt.Number());
    return CQuarnCommand::success;
}

/// Asks for the direction. Only "AntiClockwise" changes what is remembered: "Clockwise" keeps it,
/// as Enter does, and stored scripts rely on it.
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

/// What the dialog offers, besides the record that it edits.
struct DialogChoices {
    CZoetrixDataUI lists;
    KM_SimpleArray<KM_UUID> display_mode_ids; ///< of the capture list's third entry on
};

/// The render methods stand before the display modes in the capture list.
constexpr int render_method_count = 2;

void FillChoices(KM_3dmAnimationProperties& props, DialogChoices& choices) {
    KM_ClassArray<KM_wString> directions;
    directions.Append(QnLocalizeString(L"Clockwise", 40008));
    directions.Append(QnLocalizeString(L"AntiClockwise", 40009));

    KM_ClassArray<KM_wString> file_types;
    KM_ClassArray<KM_wString> capture_methods;
    KM_ClassArray<KM_wString> viewports;
    int file_type = 0;
    int capture_method = 0;
    int viewport = 0;
    GetDailogAnimationOptions(props, file_types, file_type, capture_methods, capture_method,
                              viewports, viewport, choices.display_mode_ids, false);
    choices.lists.SetFileList(file_types);
    choices.lists.SetFileListSelection(file_type);
    choices.lists.SetCaptureList(capture_methods);
    choices.lists.SetCaptureListSelection(capture_method);
    choices.lists.SetViewportList(viewports);
    choices.lists.SetViewportListSelection(viewport);
    choices.lists.SetDirectionList(directions);
    choices.lists.SetDirectionListSelection(RemembersClockwise() ? turns_clockwise
                                                                 : turns_anticlockwise);
}

/// Repairs a sequence name that cannot be a file's name, and tells so.
/// @return false, after a message, when it cannot be repaired
bool MakeNameValid(KM_wString& name) {
    if (IsValidFileName(name))
        return true;
    const KM_wString old_name = name;
    if (ReplaceInvalidFileChar(name) == 0) {
        ShowNameMessage(QnLocalizeString(L"Failed. Invalid animation name\n", 40011));
        return false;
    }
    const wchar_t* message = QnLocalizeString(
        L"The following characters cannot be used in the animation name: \\ / : * ? \" < > | . "
        L"The name was changed from (%s) to (%s). ",
        40012);
    ShowNameMessage(KM_wString::FormatToString(message, old_name.Array(), name.Array()));
    return true;
}

/// Sets render flags and display mode for the record's capture method.
void FollowCaptureMethod(KM_3dmAnimationProperties& props, const DialogChoices& choices) {
    const KM_wString& method = props.CaptureMethod();
    const bool full = method.CompareNoCase(QnLocalizeString(L"RenderFull", 19750)) == 0;
    const bool preview =
        !full && method.CompareNoCase(QnLocalizeString(L"RenderPreview", 19751)) == 0;
    const int selection = choices.lists.CaptureListSelection();
    const KM_UUID* mode = selection < render_method_count
                              ? nullptr
                              : choices.display_mode_ids.At(selection - render_method_count);
    if (!full && !preview && mode)
        props.SetDisplayMode(*mode);
    props.SetRenderFull(full);
    props.SetRenderPreview(preview);
}

/// Takes over what was selected. A selection outside its list changes nothing.
void TakeSelections(const DialogChoices& choices, KM_3dmAnimationProperties& props) {
    const CZoetrixDataUI& lists = choices.lists;
    RemembersClockwise() = lists.DirectionListSelection() == turns_clockwise;
    if (const KM_wString* type = lists.FileList().At(lists.FileListSelection()))
        props.SetFileExtension(*type);
    if (const KM_wString* method = lists.CaptureList().At(lists.CaptureListSelection()))
        props.SetCaptureMethod(*method);
    FollowCaptureMethod(props, choices);
    if (const KM_wString* viewport = lists.ViewportList().At(lists.ViewportListSelection()))
        props.SetViewportName(*viewport);
}

int AskInDialog(KM_3dmAnimationProperties& props, int& frame_count) {
    DialogChoices choices;
    FillChoices(props, choices);
    if (!LoadVexUi(true))
        return CQuarnCommand::failure;
    const QnZoetrixVexUiDialog run_dialog = QnZoetrixVexUiTurnTable();
    if (!run_dialog)
        return CQuarnCommand::failure;

    KM_3dmAnimationProperties edited = props;
    if (!run_dialog(choices.lists, edited))
        return CQuarnCommand::cancel;
    KM_wString name = edited.HtmlFilename();
    if (!MakeNameValid(name))
        return CQuarnCommand::cancel;
    // Nothing else of the edited copy counts: the rest was chosen in the lists.
    frame_count = edited.FrameCount();
    props.SetHtmlFilename(name);
    TakeSelections(choices, props);
    return CQuarnCommand::success;
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
    const int asked =
        interactive ? AskInDialog(props, frame_count) : AskAtCommandLine(doc, props, frame_count);
    if (asked != CQuarnCommand::success)
        return asked;
    if (!SetFramePoints(props, *circle, eye, frame_count))
        return EndWith(L"Failed to divide camera path. Nothing done\n", 40014,
                       CQuarnCommand::failure);

    props.SetCaptureType(KM_3dmAnimationProperties::turntable);
    props.SetCurrentFrame(0);
    props.SetFrameCount(frame_count);
    doc.Properties().SetAnimationProperties(props);
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
