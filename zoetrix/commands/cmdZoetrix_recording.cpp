#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnDisplayPipeline.h"
#include "sdk/qncore/QnFileUtilities.h"
#include "sdk/qncore/QnView.h"
#include "zoetrix/commands/cmdZoetrix.h"

namespace {

constexpr int capture_antialiasing = 2;

KM_wString FrameFileName(const KM_3dmAnimationProperties& props) {
    return props.HtmlFilename() + KM_wString::FormatToString(L"%03d.", props.CurrentFrame()) +
           props.FileExtension();
}

/// Renders the frame by a command of the host and writes what it rendered.
/// @return whether the command succeeded
bool RenderToFile(unsigned int document, const wchar_t* render_script, const KM_wString& path) {
    if (!CanBeQuotedInScript(path) || !QuarnApp().RunScript(document, render_script, 1))
        return false;
    QuarnApp().RunScript(document, L"_-SaveRenderWindowAs \"" + path + L"\"", 1);
    QuarnApp().RunScript(document, L"_CloseRenderWindow", 1);
    return true;
}

bool RenderFrame(unsigned int document, const wchar_t* render_script, const KM_wString& path,
                 CQuarnView* view) {
    const bool written = RenderToFile(document, render_script, path);
    if (view)
        view->Redraw(CQuarnView::draw_scene);
    return written;
}

/// Draws the view as it is shown, finely sampled, and writes that picture.
bool CaptureView(CQuarnView* view, const KM_wString& path) {
    CQuarnDisplayPipeline* pipeline = view ? view->ActiveViewport().DisplayPipeline() : nullptr;
    CDisplayPipelineAttributes* attributes =
        pipeline ? pipeline->CurrentDisplayAttributes() : nullptr;
    if (!attributes)
        return false;

    attributes->m_antialiasing_level = capture_antialiasing;
    CQuarnDib picture;
    if (!pipeline->DrawToDib(picture, pipeline->FrameWidth(), pipeline->FrameHeight(), *attributes))
        return false;
    // The scene is drawn once: what is recorded is also what is seen.
    pipeline->CopyToFrameBuffer(picture);
    view->Redraw(CQuarnView::show_frame_buffer);
    return picture.WriteToFile(path, 0);
}

bool CaptureFrame(unsigned int document, const KM_3dmAnimationProperties& props, CQuarnView* view,
                  const KM_wString& path) {
    if (props.RenderFull())
        return RenderFrame(document, L"_Render", path, view);
    if (props.RenderPreview())
        return RenderFrame(document, L"_RenderPreview", path, view);
    return CaptureView(view, path);
}

} // namespace

bool RecordFrame(unsigned int docSerialNumber, KM_3dmAnimationProperties& props, CQuarnView* view) {
    const KM_wString file_name = FrameFileName(props);
    if (!StaysInsideFolder(file_name) || !CQuarnFileUtilities::CreateDir(props.FolderName()))
        return false;
    const KM_wString path = props.FolderName() + L"/" + file_name;
    if (!CaptureFrame(docSerialNumber, props, view, path))
        return false;
    props.Images().Append(file_name);
    return true;
}
