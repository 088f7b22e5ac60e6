#include "host/commands/HostCommands.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

CQuarnCommand::result askSide(const wchar_t* prompt, int& side_px) {
    CQuarnGetInteger get;
    get.SetCommandPrompt(prompt);
    get.SetDefaultInteger(side_px);
    get.SetLowerLimit(1);
    get.SetUpperLimit(ViewState::largest_side_px);
    if (get.GetNumber() == CQuarnGet::number)
        side_px = get.Number();
    return get.CommandResult();
}

} // namespace

CQuarnCommand::result runViewportSize(const CQuarnCommandContext& context) {
    ViewState& view = Document::of(context.Document()).activeView();
    int width_px = view.frameWidth();
    int height_px = view.frameHeight();
    CQuarnCommand::result asked = askSide(QnLocalizeString(L"Width in pixels", 42021), width_px);
    if (asked == CQuarnCommand::success)
        asked = askSide(QnLocalizeString(L"Height in pixels", 42022), height_px);
    if (asked == CQuarnCommand::success)
        view.setFrameSize(width_px, height_px);
    return asked;
}

} // namespace quarn
