#include "engine/images/PictureMemory.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FormAsking.h"
#include "host/commands/HostCommands.h"
#include "host/commands/PictureSizePrompt.h"
#include "host/commands/ViewportSizeForm.h"
#include "host/document/Document.h"

namespace quarn {

namespace {

CQuarnCommand::result askSize(const CQuarnCommandContext& context, int& width_px, int& height_px) {
    ViewportSizeForm form(width_px, height_px);
    const auto answered = askInForm(context, form);
    if (!answered)
        return askPictureSize(width_px, height_px);
    width_px = form.width_px;
    height_px = form.height_px;
    return *answered;
}

} // namespace

CQuarnCommand::result runViewportSize(const CQuarnCommandContext& context) {
    ViewState& view = Document::of(context.Document()).activeView();
    int width_px = view.frameWidth();
    int height_px = view.frameHeight();
    const CQuarnCommand::result asked = askSize(context, width_px, height_px);
    if (asked != CQuarnCommand::success)
        return asked;
    const Result<void> fits = checkPictureMemory(width_px, height_px);
    if (!fits)
        return fail(fits.message());
    view.setFrameSize(width_px, height_px);
    return CQuarnCommand::success;
}

} // namespace quarn
