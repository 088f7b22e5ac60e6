#include "zoetrix/commands/CameraDialog.h"

#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnCommand.h"
#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/CameraSetUp.h"
#include "zoetrix/commands/cmdZoetrix.h"

namespace {

/// The render methods stand before the display modes in the capture list.
constexpr int render_method_count = 2;

using DisplayModeIds = KM_SimpleArray<KM_UUID>; ///< of the capture list's third entry on

void FillLists(KM_3dmAnimationProperties& props, CZoetrixDataUI& lists, DisplayModeIds& modes) {
    KM_ClassArray<KM_wString> file_types;
    KM_ClassArray<KM_wString> capture_methods;
    KM_ClassArray<KM_wString> viewports;
    int file_type = 0;
    int capture_method = 0;
    int viewport = 0;
    GetDailogAnimationOptions(props, file_types, file_type, capture_methods, capture_method,
                              viewports, viewport, modes, false);
    lists.SetFileList(file_types);
    lists.SetFileListSelection(file_type);
    lists.SetCaptureList(capture_methods);
    lists.SetCaptureListSelection(capture_method);
    lists.SetViewportList(viewports);
    lists.SetViewportListSelection(viewport);
}

void ShowNameMessage(const wchar_t* text) {
    QuarnMessageBox(text, QnLocalizeString(L"Animation", 40002), 0);
}

/// Repairs a sequence name that cannot be a file's name, and tells so.
/// @return false, after a message, when it cannot be repaired
bool MakeNameValid(KM_wString& name) {
    const KM_wString old_name = name;
    switch (RepairName(name)) {
    case NameRepair::not_needed:
        return true;
    case NameRepair::impossible:
        ShowNameMessage(QnLocalizeString(L"Failed. Invalid animation name\n", 40011));
        return false;
    case NameRepair::done:
        break;
    }
    const wchar_t* message = QnLocalizeString(
        L"The following characters cannot be used in the animation name: \\ / : * ? \" < > | . "
        L"The name was changed from (%s) to (%s). ",
        40012);
    ShowNameMessage(KM_wString::FormatToString(message, old_name.Array(), name.Array()));
    return true;
}

/// Sets render flags and display mode for the record's capture method.
/// @param mode  the selected display mode; null when none is
void FollowCaptureMethod(KM_3dmAnimationProperties& props, PreviewRenders preview_renders,
                         const KM_UUID* mode) {
    const KM_wString& method = props.CaptureMethod();
    const bool is_full = method.CompareNoCase(QnLocalizeString(L"RenderFull", 19750)) == 0;
    const bool is_preview =
        !is_full && method.CompareNoCase(QnLocalizeString(L"RenderPreview", 19751)) == 0;
    if (!is_full && !is_preview && mode)
        props.SetDisplayMode(*mode);
    const bool previews = is_preview && preview_renders == PreviewRenders::preview;
    props.SetRenderFull(is_full || (is_preview && !previews));
    props.SetRenderPreview(previews);
}

void TakeSelections(const CZoetrixDataUI& lists, const DisplayModeIds& modes,
                    PreviewRenders preview_renders, KM_3dmAnimationProperties& props) {
    if (const KM_wString* type = lists.FileList().At(lists.FileListSelection()))
        props.SetFileExtension(*type);
    const int selection = lists.CaptureListSelection();
    if (const KM_wString* method = lists.CaptureList().At(selection))
        props.SetCaptureMethod(*method);
    const KM_UUID* mode =
        selection < render_method_count ? nullptr : modes.At(selection - render_method_count);
    FollowCaptureMethod(props, preview_renders, mode);
    if (const KM_wString* viewport = lists.ViewportList().At(lists.ViewportListSelection()))
        props.SetViewportName(*viewport);
}

} // namespace

int AskInDialog(const CameraDialog& dialog, CZoetrixDataUI& lists, KM_3dmAnimationProperties& props,
                int& frame_count) {
    DisplayModeIds modes;
    FillLists(props, lists, modes);
    if (!LoadVexUi(true))
        return CQuarnCommand::failure;
    const QnZoetrixVexUiDialog run_dialog = dialog.find();
    if (!run_dialog)
        return CQuarnCommand::failure;

    KM_3dmAnimationProperties edited = props;
    edited.SetFrameCount(frame_count);
    if (!run_dialog(lists, edited))
        return CQuarnCommand::cancel;
    KM_wString name = edited.HtmlFilename();
    if (!MakeNameValid(name))
        return CQuarnCommand::cancel;
    // Nothing else of the edited copy counts: the rest was chosen in the lists.
    frame_count = edited.FrameCount();
    props.SetHtmlFilename(name);
    TakeSelections(lists, modes, dialog.preview_renders, props);
    return CQuarnCommand::success;
}

int AskInPathDialog(KM_3dmAnimationProperties& props, int& frame_count) {
    CZoetrixDataUI lists;
    return AskInDialog({QnZoetrixVexUiPathAnimation, PreviewRenders::full}, lists, props,
                       frame_count);
}
