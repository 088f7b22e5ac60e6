#include "engine/images/ImageFile.h"
#include "engine/images/Opacity.h"
#include "host/app/Application.h"
#include "host/app/PictureOpacity.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FileAsking.h"
#include "host/commands/HostCommands.h"
#include "host/commands/WatchedRendering.h"
#include "host/document/DocumentList.h"
#include "host/document/SceneChanges.h"
#include "host/front_end/FrontEnd.h"
#include "sdk/qncore/QnLocalize.h"

#include <utility>

namespace quarn {

namespace {

ShownPicture asShown(const Image& picture) {
    return {picture.width, picture.height, picture.rgba};
}

/// Renders the active view, or the one that the command which runs this one has placed, into the
/// render window. One that is cancelled or fails leaves the picture that was there. Where that
/// command could not save the picture before, it would not save this one either.
CQuarnCommand::result renderView(Document& document, int samples) {
    if (const std::string& trouble = document.list().unsavedPicture(); !trouble.empty())
        return fail(trouble + " No more pictures are rendered.");
    if (!document.list().wantsPictures())
        return CQuarnCommand::success;
    RenderWindow& window = document.renderWindow();
    const RenderRequest request{window.settings.width_px, window.settings.height_px, samples};
    ViewState& view = document.list().viewToRender(document);
    const KM_Viewport viewport = view.viewport();
    FrontEnd& front_end = document.frontEnd();
    Renderer::Shown so_far;
    if (front_end.mainWindow()) // else there is no render window either
        so_far = [&](const Image& picture) { front_end.renderWindowShown(asShown(picture)); };
    Image picture;
    const auto end = renderWatched(document, viewport, request, picture, SceneChanges(), so_far);
    const bool is_done = end && end.value() == RenderEnd::done;
    if (end)
        view.tellCameraOutOfRange();
    if (is_done)
        window.picture = std::move(picture);
    if (is_done || so_far)
        front_end.renderWindowShown(asShown(window.picture));
    if (!end)
        return fail(end.message());
    return is_done ? CQuarnCommand::success : CQuarnCommand::cancel;
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
    Document& document = Document::of(context.Document());
    const RenderWindow& window = document.renderWindow();
    if (!window.isOpen() && document.list().wantsPictures())
        return fail("There is no rendered picture. Make one with Render or RenderPreview first.");
    std::filesystem::path file;
    const CQuarnCommand::result asked =
        askFile(context, FileUse::save_rendering, QnLocalizeString(L"Image file", 42201), file);
    if (asked != CQuarnCommand::success)
        return asked;
    if (isSeeThrough(window.picture))
        if (const auto why = whyHoldsNoOpacity(file.extension().string()))
            return fail(*why);
    Application& application = *Application::current();
    if (!application.mayWrite(file)) {
        document.list().noteUnsavedPicture("The picture was not written.");
        return CQuarnCommand::failure;
    }
    if (application.passesOver(file))
        return CQuarnCommand::success;
    const auto written =
        writeImageFile(file, window.picture, application.protection(), application.jpegQuality());
    document.list().noteUnsavedPicture(written ? std::string() : written.message());
    if (!written)
        return fail(written.message());
    application.pictureWritten(file, window.picture);
    return CQuarnCommand::success;
}

CQuarnCommand::result runCloseRenderWindow(const CQuarnCommandContext& context) {
    Document& document = Document::of(context.Document());
    document.renderWindow().close();
    document.frontEnd().renderWindowShown({});
    return CQuarnCommand::success;
}

} // namespace quarn
