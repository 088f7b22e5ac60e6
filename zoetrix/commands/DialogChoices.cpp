#include "zoetrix/commands/DialogChoices.h"

#include "sdk/qncore/QnCommand.h"
#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/cmdZoetrix.h"

namespace {

/// The render methods stand before the display modes in the capture list.
constexpr int render_method_count = 2;

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

} // namespace

void FillLists(KM_3dmAnimationProperties& props, bool sun_filter, CZoetrixDataUI& lists,
               DisplayModeIds& modes) {
    KM_ClassArray<KM_wString> file_types;
    KM_ClassArray<KM_wString> capture_methods;
    KM_ClassArray<KM_wString> viewports;
    int file_type = 0;
    int capture_method = 0;
    int viewport = 0;
    GetDailogAnimationOptions(props, file_types, file_type, capture_methods, capture_method,
                              viewports, viewport, modes, sun_filter);
    lists.SetFileList(file_types);
    lists.SetFileListSelection(file_type);
    lists.SetCaptureList(capture_methods);
    lists.SetCaptureListSelection(capture_method);
    lists.SetViewportList(viewports);
    lists.SetViewportListSelection(viewport);
}

int RunDialog(FindDialog find, CZoetrixDataUI& lists, KM_3dmAnimationProperties& edited) {
    if (!LoadVexUi(true))
        return CQuarnCommand::failure;
    const QnZoetrixVexUiDialog run_dialog = find();
    if (!run_dialog)
        return CQuarnCommand::failure;
    return run_dialog(lists, edited) ? CQuarnCommand::success : CQuarnCommand::cancel;
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
