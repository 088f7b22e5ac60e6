#include "host/app/Application.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FileAsking.h"
#include "host/commands/HostCommands.h"
#include "host/commands/Rendering.h"
#include "host/display/ImageFile.h"
#include "host/document/DocumentList.h"
#include "host/document/SceneChanges.h"
#include "host/front_end/FrontEnd.h"
#include "sdk/qncore/QnLocalize.h"

#include <utility>

namespace quarn {

namespace {

/// Renders the active view, or the one that the command which runs this one has placed, into the
/// render window. One that is cancelled or fails leaves the picture that was there.
CQuarnCommand::result renderView(Document& document, int samples) {
    RenderWindow& window = document.renderWindow();
    const RenderRequest request{window.settings.width_px, window.settings.height_px, samples};
    const KM_Viewport viewport = document.list().viewToRender(document).viewport();
    Image picture;
    const auto end = renderWatched(document, viewport, request, picture, SceneChanges());
    if (!end)
        return fail(end.message());
    if (end.value() == RenderEnd::cancelled)
        return CQuarnCommand::cancel;
    window.picture = std::move(picture);
    document.frontEnd().renderWindowShown(
        {window.picture.width, window.picture.height, window.picture.rgba});
    return CQuarnCommand::success;
}

} // namespace

CQuarnCommand::result runRender(const CQuarnCommandContext& context) {
    Document& document = Document::of(context.Document());
    return renderView(document, document.renderWindow().settings.samples);
}

CQuarnCommand::result runRenderPreview(const CQuarnCommandContext& context) {
    Document& document = Document::of(context.Document());
    return renderView(document, document.renderWindow().settings.preview_samples);
}

CQuarnCommand::result runSaveRenderWindowAs(const CQuarnCommandContext& context) {
    const RenderWindow& window = Document::of(context.Document()).renderWindow();
    if (!window.isOpen())
        return fail("There is no rendered picture. Make one with Render or RenderPreview first.");
    std::filesystem::path file;
    const CQuarnCommand::result asked =
        askFile(context, FileUse::save_rendering, QnLocalizeString(L"Image file", 42201), file);
    if (asked != CQuarnCommand::success)
        return asked;
    const auto written = writeImageFile(file, window.picture);
    if (!written)
        return fail(written.message());
    Application::current()->pictureWritten(file);
    return CQuarnCommand::success;
}

CQuarnCommand::result runCloseRenderWindow(const CQuarnCommandContext& context) {
    Document& document = Document::of(context.Document());
    document.renderWindow().close();
    document.frontEnd().renderWindowShown({});
    return CQuarnCommand::success;
}

} // namespace quarn
