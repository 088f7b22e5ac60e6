#include "zoetrix/commands/CameraDialog.h"

#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnCommand.h"
#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/CameraSetUp.h"

namespace {

void ShowNameMessage(const wchar_t* text) {
    QuarnMessageBox(text, QnLocalizeString(L"Animation", 40002), 0);
}

/// Repairs a sequence name that cannot be a file's name, and tells so.
/// @return false, after a message, when it cannot be repaired
bool MakeNameValid(KM_wString& name) {
    const KM_wString old_name = name;
    switch (RepairName(name)) {
    case NameRepair::not_needed:
        return true;
    case NameRepair::impossible:
        ShowNameMessage(QnLocalizeString(L"Failed. Invalid animation name\n", 40011));
        return false;
    case NameRepair::done:
        break;
    }
    const wchar_t* message = QnLocalizeString(
        L"The following characters cannot be used in the animation name: \\ / : * ? \" < > | . "
        L"The name was changed from (%s) to (%s). ",
        40012);
    ShowNameMessage(KM_wString::FormatToString(message, old_name.Array(), name.Array()));
    return true;
}

} // namespace

int AskInDialog(const CameraDialog& dialog, CZoetrixDataUI& lists, KM_3dmAnimationProperties& props,
                int& frame_count) {
    DisplayModeIds modes;
    FillLists(props, false, lists, modes);
    KM_3dmAnimationProperties edited = props;
    edited.SetFrameCount(frame_count);
    if (const int asked = RunDialog(dialog.find, lists, edited); asked != CQuarnCommand::success)
        return asked;
    KM_wString name = edited.HtmlFilename();
    if (!MakeNameValid(name))
        return CQuarnCommand::cancel;
    // Nothing else of the edited copy counts: the rest was chosen in the lists.
    frame_count = edited.FrameCount();
    props.SetHtmlFilename(name);
    TakeSelections(lists, modes, dialog.preview_renders, props);
    return CQuarnCommand::success;
}

int AskInPathDialog(KM_3dmAnimationProperties& props, int& frame_count) {
    CZoetrixDataUI lists;
    return AskInDialog({QnZoetrixVexUiPathAnimation, PreviewRenders::full}, lists, props,
                       frame_count);
}
