#include "host/commands/PictureSizePrompt.h"

#include "host/document/ViewState.h"
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

CQuarnCommand::result askPictureSize(int& width_px, int& height_px) {
    const CQuarnCommand::result asked =
        askSide(QnLocalizeString(L"Width in pixels", 42021), width_px);
    if (asked != CQuarnCommand::success)
        return asked;
    return askSide(QnLocalizeString(L"Height in pixels", 42022), height_px);
}

} // namespace quarn
