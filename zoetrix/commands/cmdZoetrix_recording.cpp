#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnDisplayPipeline.h"
#include "sdk/qncore/QnFileUtilities.h"
#include "sdk/qncore/QnView.h"
#include "zoetrix/commands/cmdZoetrix.h"

#include <cwchar>
#include <iterator>

namespace {

constexpr int capture_antialiasing = 2;

void SetFrameFileName(const KM_3dmAnimationProperties& props, KM_wString& name) {
    wchar_t number_and_dot[16];
    std::swprintf(number_and_dot, std::size(number_and_dot), L"%03d.", props.CurrentFrame());
    name = props.HtmlFilename();
    name += number_and_dot;
    name += props.FileExtension();
}

void SetFramePath(const KM_3dmAnimationProperties& props, const KM_wString& name,
                  KM_wString& path) {
    path = props.FolderName();
    path += L'/';
    path += name;
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
bool CaptureView(CQuarnView* view, CQuarnDib& picture, const KM_wString& path) {
    CQuarnDisplayPipeline* pipeline = view ? view->ActiveViewport().DisplayPipeline() : nullptr;
    CDisplayPipelineAttributes* attributes =
        pipeline ? pipeline->CurrentDisplayAttributes() : nullptr;
    if (!attributes)
        return false;

    attributes->m_antialiasing_level = capture_antialiasing;
    if (!pipeline->DrawToDib(picture, pipeline->FrameWidth(), pipeline->FrameHeight(), *attributes))
        return false;
    // The scene is drawn once: what is recorded is also what is seen.
    pipeline->CopyToFrameBuffer(picture);
    view->Redraw(CQuarnView::show_frame_buffer);
    return picture.WriteToFile(path, 0);
}

bool CaptureFrame(unsigned int document, const KM_3dmAnimationProperties& props, CQuarnView* view,
                  FrameBuffers& buffers) {
    if (props.RenderFull())
        return RenderFrame(document, L"_Render", buffers.path, view);
    if (props.RenderPreview())
        return RenderFrame(document, L"_RenderPreview", buffers.path, view);
    return CaptureView(view, buffers.picture, buffers.path);
}

} // namespace

bool RecordFrame(unsigned int docSerialNumber, KM_3dmAnimationProperties& props, CQuarnView* view) {
    FrameBuffers buffers;
    return RecordFrame(docSerialNumber, props, view, buffers);
}

bool RecordFrame(unsigned int docSerialNumber, KM_3dmAnimationProperties& props, CQuarnView* view,
                 FrameBuffers& buffers) {
    SetFrameFileName(props, buffers.file_name);
    if (!StaysInsideFolder(buffers.file_name) ||
        !CQuarnFileUtilities::CreateDir(props.FolderName()))
        return false;
    SetFramePath(props, buffers.file_name, buffers.path);
    if (!CaptureFrame(docSerialNumber, props, view, buffers))
        return false;
    props.Images().Append(buffers.file_name);
    return true;
}
