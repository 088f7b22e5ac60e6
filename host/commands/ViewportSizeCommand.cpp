#include "host/commands/HostCommands.h"
#include "host/commands/PictureSizePrompt.h"
#include "host/document/Document.h"

namespace quarn {

CQuarnCommand::result runViewportSize(const CQuarnCommandContext& context) {
    ViewState& view = Document::of(context.Document()).activeView();
    int width_px = view.frameWidth();
    int height_px = view.frameHeight();
    const CQuarnCommand::result asked = askPictureSize(width_px, height_px);
    if (asked == CQuarnCommand::success)
        view.setFrameSize(width_px, height_px);
    return asked;
}

} // namespace quarn
