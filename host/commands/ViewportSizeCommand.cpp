#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/commands/PictureSizePrompt.h"
#include "host/display/PictureMemory.h"
#include "host/document/Document.h"

namespace quarn {

CQuarnCommand::result runViewportSize(const CQuarnCommandContext& context) {
    ViewState& view = Document::of(context.Document()).activeView();
    int width_px = view.frameWidth();
    int height_px = view.frameHeight();
    const CQuarnCommand::result asked = askPictureSize(width_px, height_px);
    if (asked != CQuarnCommand::success)
        return asked;
    const Result<void> fits = checkPictureMemory(width_px, height_px);
    if (!fits)
        return fail(fits.message());
    view.setFrameSize(width_px, height_px);
    return CQuarnCommand::success;
}

} // namespace quarn
